#include "app/desktop/MprisPlaylists.h"

#include <QCryptographicHash>
#include <QDBusArgument>
#include <QDBusMetaType>
#include <QDateTime>
#include <QDirIterator>
#include <QFileInfo>
#include <algorithm>

#include "CommonRUKTools/Clock.h"
#include "CommonRUKTools/Collation.h"
#include "MusicManagment/playlist/PlayList.h"
#include "app/desktop/MimeTypes.h"

using namespace Qt::StringLiterals;

// A playlist as the bus writes it, and one that may be missing.
struct MprisPlaylist {
    QDBusObjectPath Id{u"/"_s};
    QString Name{};
    QString Icon{};
};
struct MaybePlaylist {
    bool IsThere = false;
    MprisPlaylist Playlist{};
};
Q_DECLARE_METATYPE(MprisPlaylist)
Q_DECLARE_METATYPE(MaybePlaylist)

static QDBusArgument& operator<<(QDBusArgument& out, const MprisPlaylist& list) {
    out.beginStructure();
    out << list.Id << list.Name << list.Icon;
    out.endStructure();
    return out;
}
static const QDBusArgument& operator>>(const QDBusArgument& in, MprisPlaylist& list) {
    in.beginStructure();
    in >> list.Id >> list.Name >> list.Icon;
    in.endStructure();
    return in;
}
static QDBusArgument& operator<<(QDBusArgument& out, const MaybePlaylist& list) {
    out.beginStructure();
    out << list.IsThere << list.Playlist;
    out.endStructure();
    return out;
}
static const QDBusArgument& operator>>(const QDBusArgument& in, MaybePlaylist& list) {
    in.beginStructure();
    in >> list.IsThere >> list.Playlist;
    in.endStructure();
    return in;
}

namespace {

// A folder that is full of other things costs no more than that.
constexpr int kMostLookedAt = 10'000;
constexpr qint64 kFresh = 1000;  // ms

QDBusObjectPath IdOf(const QString& path) {
    const QByteArray digest = QCryptographicHash::hash(path.toUtf8(), QCryptographicHash::Sha1).toHex();
    return QDBusObjectPath(u"/tunestead/playlist/"_s + QString::fromLatin1(digest));
}

MprisPlaylist DescriptionOf(const QString& path) {
    return {IdOf(path), QFileInfo(path).completeBaseName(), {}};
}

void AddListsIn(const QString& folder, QStringList& files) {
    if (folder.isEmpty()) return;
    QDirIterator entries(folder, QDir::Files);
    for (int i = 0; i < kMostLookedAt && entries.hasNext() && files.size() < MprisPlaylists::kMost; ++i) {
        const QString path = entries.next();
        if (KindOfFile(path) == FileKind::PlayList && !files.contains(path)) files << path;
    }
}

}  // namespace

MprisPlaylists::MprisPlaylists(const TPlayList& list, Options options)
    : list_(list), options_(std::move(options)) {
    qDBusRegisterMetaType<MprisPlaylist>();
    qDBusRegisterMetaType<QList<MprisPlaylist>>();
    qDBusRegisterMetaType<MaybePlaylist>();
}

QString MprisPlaylists::Open() const {
    return list_.PlayListFileName() == options_.StandardList ? QString() : list_.PlayListFileName();
}

const QStringList& MprisPlaylists::Files() const {
    const QString open = Open();
    const qint64 now = CurrentClock().Ticks();
    if (filesTime_ && now - *filesTime_ < kFresh && filesBeside_ == open) return files_;
    files_.clear();
    if (!open.isEmpty()) {
        files_ << open;
        AddListsIn(QFileInfo(open).path(), files_);
    }
    if (options_.MusicFolder) AddListsIn(options_.MusicFolder(), files_);
    filesBeside_ = open;
    filesTime_ = now;
    return files_;
}

QVariantMap MprisPlaylists::Properties() const {
    return {{u"PlaylistCount"_s, static_cast<uint>(Files().size())},
            {u"Orderings"_s, QStringList({u"Alphabetical"_s, u"Modified"_s})},
            {u"ActivePlaylist"_s, Active()}};
}

QVariant MprisPlaylists::Active() const {
    const QString path = Open();
    MaybePlaylist active{.IsThere = !path.isEmpty()};
    if (active.IsThere) active.Playlist = DescriptionOf(path);
    return QVariant::fromValue(active);
}

std::optional<QVariantList> MprisPlaylists::Call(const QString& method, const QVariantList& arguments) {
    if (method == u"GetPlaylists"_s) return Listed(arguments);
    if (method != u"ActivatePlaylist"_s) return std::nullopt;
    Activate(arguments.value(0).value<QDBusObjectPath>());
    return QVariantList();
}

QVariantList MprisPlaylists::Listed(const QVariantList& arguments) const {
    QStringList files = Files();
    if (arguments.value(2).toString() == u"Modified"_s)
        std::ranges::stable_sort(files, {},
                                 [](const QString& path) { return QFileInfo(path).lastModified(); });
    else
        std::ranges::stable_sort(files, [](const QString& a, const QString& b) {
            return Collation::CompareIgnoringCase(QFileInfo(a).fileName(), QFileInfo(b).fileName()) < 0;
        });
    if (arguments.value(3).toBool()) std::ranges::reverse(files);
    QList<MprisPlaylist> lists;
    for (const QString& path : files.mid(arguments.value(0).toUInt(), arguments.value(1).toUInt()))
        lists << DescriptionOf(path);
    return {QVariant::fromValue(lists)};
}

void MprisPlaylists::Activate(const QDBusObjectPath& id) {
    const QStringList& files = Files();
    const auto wanted = std::ranges::find_if(files, [&](const QString& path) { return IdOf(path) == id; });
    if (wanted == files.end()) throw EPlayListException(u"Diese PlayList gibt es nicht mehr."_s);
    options_.Play(QString(*wanted));  // the files may be listed anew meanwhile
}
