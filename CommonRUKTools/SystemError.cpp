#include "CommonRUKTools/SystemError.h"

#include <algorithm>
#include <cerrno>
#include <iterator>

using namespace Qt::StringLiterals;

namespace {

struct Row {
    int Error;
    QStringView Text;
};

constexpr Row kTexts[] = {
    {ENOSPC, u"Der Datenträger ist voll"},
#ifdef EDQUOT
    {EDQUOT, u"Der Speicherplatz dieses Benutzers ist verbraucht"},
#endif
    {EFBIG, u"Die Datei ist zu groß für diesen Datenträger"},
    {EROFS, u"Der Datenträger ist schreibgeschützt"},
    {EACCES, u"Keine Berechtigung"},
    {EPERM, u"Keine Berechtigung"},
    {ENOENT, u"Datei oder Ordner nicht gefunden"},
    {ENOTDIR, u"Ein Teil des Pfades ist kein Ordner"},
    {EISDIR, u"Das ist ein Ordner"},
    {EEXIST, u"Die Datei gibt es schon"},
    {ENAMETOOLONG, u"Der Name ist zu lang"},
    {ELOOP, u"Zu viele Verknüpfungen hintereinander"},
    {EINVAL, u"Das ist hier nicht möglich"},
    {EIO, u"Ein-/Ausgabefehler des Datenträgers"},
    {ENXIO, u"Das Gerät ist nicht da"},
    {ENODEV, u"Das Gerät ist nicht da"},
    {EBUSY, u"Die Datei wird gerade benutzt"},
    {EMFILE, u"Zu viele offene Dateien"},
    {ENFILE, u"Zu viele offene Dateien"},
    {ENOMEM, u"Der Speicher reicht nicht aus"},
#ifdef ESTALE
    {ESTALE, u"Das Netzlaufwerk ist nicht mehr da"},
#endif
    {ETIMEDOUT, u"Der Datenträger antwortet nicht"},
};

}  // namespace

QString SystemErrorText(int error) {
    const auto* row = std::ranges::find(kTexts, error, &Row::Error);
    return row != std::end(kTexts) ? row->Text.toString()
                                   : u"Fehler des Systems Nr. "_s + QString::number(error);
}
