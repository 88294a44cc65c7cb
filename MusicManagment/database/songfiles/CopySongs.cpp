#include "MusicManagment/database/songfiles/CopySongs.h"

#include <QDir>
#include <QFileInfo>

#include "CommonRUKTools/Dialogs.h"
#include "MusicManagment/database/Progress.h"
#include "MusicManagment/database/songfiles/BlockCopy.h"
#include "MusicManagment/database/songfiles/SongFinder.h"

using namespace Qt::StringLiterals;

namespace {

enum class Existing { Ask, Replace, Skip };

// Asks once a file, or once for all.
class CollisionPolicy {
 public:
    // Throws EAbort on cancel.
    bool MayReplace(const QString& name) {
        if (policy_ != Existing::Ask) return policy_ == Existing::Replace;
        const int answer =
            UserDialogs().Ask({.Text = u"Die Datei "_s + name + u" existiert bereits."_s,
                               .Buttons = {u"Ersetzen"_s, u"Alle ersetzen"_s, u"Überspringen"_s,
                                           u"Alle überspringen"_s, u"Abbrechen"_s},
                               .Cancel = 4,
                               .Default = 2});
        if (answer == 4) throw EAbort();
        if (answer == 1) policy_ = Existing::Replace;
        if (answer == 3) policy_ = Existing::Skip;
        return answer < 2;
    }

 private:
    Existing policy_ = Existing::Ask;
};

class Copier {
 public:
    Copier(TMusicDatabase& database, const QString& folder, int total)
        : database_(database), finder_(database), folder_(folder), total_(total) {}

    // False when the user asked to stop.
    bool Copy(int number, const QString& song, CopyResult& result) {
        const QString path = finder_.Find(song);
        const QString name = QFileInfo(path).fileName();
        const QString target = folder_.filePath(name);
        try {
            if (path.isEmpty()) throw EStreamError(u"Der Datenträger ist nicht eingelegt"_s);
            FileSource source(path);
            if (QFileInfo(target) == QFileInfo(path))
                throw EStreamError(u"Quelle und Ziel sind dieselbe Datei"_s);
            if (QFileInfo::exists(target) && !collisions_.MayReplace(name)) return true;
            SafeFile file(target);
            if (!CopyBytes(number, name, source, file)) return false;
            file.Commit();
            ++result.Copied;
        } catch (const EStreamError& error) {
            result.Failed << song + u": "_s + error.Message();
        }
        return true;
    }

 private:
    bool CopyBytes(int number, const QString& name, ByteSource& source, SafeFile& target) {
        return CopyBlocks(source, target, [&](std::int64_t done) {
            return database_.Progress({.Cur = number,
                                       .Max = total_,
                                       .CurSub = done,
                                       .MaxSub = source.Size(),
                                       .Type = ptCopySongs,
                                       .Description = name});
        });
    }

    TMusicDatabase& database_;
    SongFinder finder_;
    QDir folder_;
    int total_;
    CollisionPolicy collisions_;
};

}  // namespace

CopyResult CopySongs(TMusicDatabase& database, const QStringList& paths, const QString& folder) {
    const ProgressRun run(database, u"Kopiere die Songs an die Zielorte"_s);
    Copier copier(database, folder, static_cast<int>(paths.size()));
    CopyResult result;
    for (int i = 0; i < paths.size() && !result.Stopped; ++i)
        result.Stopped = !copier.Copy(i, paths[i], result);
    return result;
}
