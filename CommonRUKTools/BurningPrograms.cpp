#include "CommonRUKTools/BurningPrograms.h"

#include <QUrl>

using namespace Qt::StringLiterals;

namespace {

enum class FolderAs { Path, Address };

struct Row {
    const char16_t* Name;
    const char16_t* Program;
    const char16_t* Option;  // a new disc of data with what follows, as its own help says
    FolderAs Folder;
};

constexpr Row kRows[] = {
    {u"Brasero", u"brasero", u"--data", FolderAs::Address},
    {u"K3b", u"k3b", u"--data", FolderAs::Path},
    {u"Xfburn", u"xfburn", u"--data-composition", FolderAs::Path},
};

}  // namespace

std::optional<BurningCall> FindBurningProgram(const QString& folder, const ProgramFinder& find) {
    for (const Row& row : kRows) {
        const QString program = find(QString::fromUtf16(row.Program));
        if (program.isEmpty()) continue;
        const QString given = row.Folder == FolderAs::Address
                                  ? QUrl::fromLocalFile(folder).toString(QUrl::FullyEncoded)
                                  : folder;
        return BurningCall{QString::fromUtf16(row.Name), program, {QString::fromUtf16(row.Option), given}};
    }
    return std::nullopt;
}
