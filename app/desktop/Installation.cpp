#include "app/desktop/Installation.h"

#include <QCoreApplication>
#include <QDir>
#include <QFile>
#include <QFileInfo>
#include <QStandardPaths>
#include <algorithm>

#include "CommonRUKTools/Errors.h"
#include "CommonRUKTools/SafeFile.h"
#include "app/desktop/DesktopEntry.h"
#include "app/desktop/MimeTypes.h"

using namespace Qt::StringLiterals;

namespace {

const QString kEntryName = u"tunestead.desktop"_s;

QByteArray Contents(const QString& path) {
    QFile file(path);
    if (!file.open(QIODevice::ReadOnly)) return {};
    return file.readAll();
}

// The program's own copy of a file that a package puts into the system's folders.
QByteArray Packed(const QString& name) {
    return Contents(u":/desktop/"_s + name);
}

void Write(const QString& path, const QByteArray& contents) {
    const QString folder = QFileInfo(path).path();
    if (!QDir().mkpath(folder)) throw EStreamError(u"Kann den Ordner "_s + folder + u" nicht anlegen."_s);
    SafeFile file(path);
    file.Write(AsBytes(std::string_view(contents.constData(), static_cast<std::size_t>(contents.size()))));
    file.Commit();
}

void RemoveFile(const QString& path) {
    if (QFileInfo(path).exists() && !QFile::remove(path))
        throw EStreamError(u"Kann die Datei "_s + path + u" nicht entfernen."_s);
}

QString Shortcut(const QString& linkFolder) {
    return linkFolder + u'/' + kEntryName;
}

QStringList OwnMimeTypes() {
    QStringList types;
    for (const FileType& type : OwnFileTypes())
        types << type.MimeType.toString();
    return types;
}

}  // namespace

InstallationPlaces InstallationPlaces::OfThisUser() {
    return {QCoreApplication::applicationFilePath(),
            QStandardPaths::writableLocation(QStandardPaths::GenericDataLocation),
            QStandardPaths::writableLocation(QStandardPaths::GenericConfigLocation)};
}

Installation::Installation(InstallationPlaces places, ToolRunner run)
    : places_(std::move(places)), run_(std::move(run)) {}

QStringList Installation::Install(const QString& linkFolder) {
    QStringList complaints = WriteFiles();
    if (!linkFolder.isEmpty()) {
        Write(Shortcut(linkFolder), DesktopEntry());
        // Desktops start a shortcut outside of the menu's folders only when it is executable.
        QFile shortcut(Shortcut(linkFolder));
        shortcut.setPermissions(shortcut.permissions() | QFile::ExeOwner);
    }
    // Types of the system (.m3u, .pls and songs) keep the program that the user has chosen for them.
    complaints << run_(u"xdg-mime"_s, QStringList{u"default"_s, kEntryName} + OwnMimeTypes());
    complaints.removeAll(QString());
    return complaints;
}

// Writing into the user's folders at every start would surprise those who only try the program, and would
// undo what a user has changed there, so only an installation of this program is kept up to date.
QStringList Installation::Refresh() {
    const QString installed = InstalledProgram(Contents(DesktopFile()));
    if (installed.isEmpty() || (installed != places_.Program && QFileInfo::exists(installed))) return {};
    const auto files = Files();
    const auto isCurrent = [](const File& file) { return Contents(file.Path) == file.Contents; };
    if (std::ranges::all_of(files, isCurrent)) return {};
    return WriteFiles();
}

QStringList Installation::Remove(const QString& linkFolder) {
    for (const File& file : Files())
        RemoveFile(file.Path);
    // A file of this name in a folder of the user's may be the user's.
    if (!linkFolder.isEmpty() && !InstalledProgram(Contents(Shortcut(linkFolder))).isEmpty())
        RemoveFile(Shortcut(linkFolder));
    RemoveDefaults();
    return UpdateCaches();
}

QStringList Installation::WriteFiles() const {
    for (const File& file : Files())
        Write(file.Path, file.Contents);
    return UpdateCaches();
}

QByteArray Installation::DesktopEntry() const {
    return EntryFor(Packed(kEntryName), places_.Program);
}

QString Installation::DesktopFile() const {
    return places_.DataFolder + u"/applications/"_s + kEntryName;
}

std::vector<Installation::File> Installation::Files() const {
    return {
        {DesktopFile(), DesktopEntry()},
        {places_.DataFolder + u"/icons/hicolor/scalable/apps/tunestead.svg"_s, Packed(u"tunestead.svg"_s)},
        {places_.DataFolder + u"/mime/packages/tunestead.xml"_s, Packed(u"tunestead-mime.xml"_s)}};
}

QStringList Installation::UpdateCaches() const {
    const QString mime = places_.DataFolder + u"/mime"_s;
    const QString applications = places_.DataFolder + u"/applications"_s;
    const QString icons = places_.DataFolder + u"/icons/hicolor"_s;
    QStringList complaints;
    if (QFileInfo(mime).isDir()) complaints << run_(u"update-mime-database"_s, {mime});
    if (QFileInfo(applications).isDir()) complaints << run_(u"update-desktop-database"_s, {applications});
    // A cache where there was none would hide the icons that others put there later without renewing it.
    if (QFileInfo::exists(icons + u"/icon-theme.cache"_s))
        complaints << run_(u"gtk-update-icon-cache"_s, {u"-q"_s, u"-f"_s, u"-t"_s, icons});
    complaints.removeAll(QString());
    return complaints;
}

// xdg-mime can set a default and not take it back.
void Installation::RemoveDefaults() const {
    const QString path = places_.ConfigFolder + u"/mimeapps.list"_s;
    const QByteArray before = Contents(path);
    const QByteArray after = WithoutDefaults(before, kEntryName, OwnMimeTypes());
    if (after == before) return;
    if (after.contains('='))
        Write(path, after);
    else
        RemoveFile(path);  // the headings that xdg-mime made are all that is left
}
