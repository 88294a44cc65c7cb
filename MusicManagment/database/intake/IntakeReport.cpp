#include "MusicManagment/database/intake/IntakeReport.h"

#include "CommonRUKTools/CodePage.h"
#include "CommonRUKTools/Errors.h"
#include "CommonRUKTools/PrivateFolder.h"
#include "CommonRUKTools/SafeFile.h"
#include "CommonRUKTools/Shell.h"

using namespace Qt::StringLiterals;

namespace {

void AppendLines(const QStringList& lines, QString& text) {
    for (const QString& line : lines)
        text += line + u'\n';
}

// A ban is what the user wished, and so no complaint.
std::vector<ReportSection> NotTaken(const IntakeResult& result) {
    return {{u"Nicht gelesen werden konnte(n)"_s, result.UnreadableNames, true},
            {u"Aufgenommen, aber ohne erkennbaren Ton"_s, result.DamagedFiles, true},
            {u"Nicht aufgenommen, weil in der Bann-Liste"_s, result.BannedFiles}};
}

// Returns its path. In a folder of the user's own: in the common one others could put a link under the name.
QString WriteDetails(const QString& details) {
    QString path = PrivateTemporaryFolder(u"Tunestead"_s) + u"/Tunestead - Änderungen in der Datenbank.txt"_s;
    const QByteArray bytes = CodePage::ToSystem(details);
    SafeFile file(path);
    file.Write(AsBytes({bytes.constData(), static_cast<std::size_t>(bytes.size())}));
    file.Commit();
    return path;
}

void ShowDetails(const QString& details) {
    try {
        const QString path = WriteDetails(details);
        if (!CurrentShell().OpenWithDefaultProgram(path))
            UserDialogs().ShowMessage(MessageKind::Error, u"Kann die Datei nicht anzeigen: "_s + path);
    } catch (const EStreamError& error) {
        UserDialogs().ShowMessage(MessageKind::Error, error.Message());
    }
}

}  // namespace

QString IntakeMessage(const IntakeResult& result) {
    return u"Es wurde(n) "_s + QString::number(result.Added) +
           u" neue(r) Song(s) in die Datenbank aufgenommen."_s;
}

QString IntakeDetails(const IntakeResult& result) {
    QString text =
        u"Folgende(r) Song(s) ("_s + QString::number(result.Added) + u") wurde(n) neu aufgenommen:\n"_s;
    AppendLines(result.NewFiles, text);
    for (const ReportSection& section : NotTaken(result)) {
        if (section.Lines.isEmpty()) continue;
        text += u'\n' + section.Caption + u" ("_s + QString::number(section.Lines.size()) + u"):\n"_s;
        AppendLines(section.Lines, text);
    }
    return text;
}

std::vector<ReportSection> IntakeSections(const IntakeResult& result) {
    std::vector<ReportSection> sections = NotTaken(result);
    sections.insert(sections.begin(), {u"Neu aufgenommen"_s, result.NewFiles});
    return sections;
}

void ShowReport(const QString& message, std::vector<ReportSection> sections, const QString& details) {
    std::erase_if(sections, [](const ReportSection& section) { return section.Lines.isEmpty(); });
    UserDialogs().ShowReport({message, std::move(sections), [details] { ShowDetails(details); }});
}

void ReportIntake(const IntakeResult& result) {
    ShowReport(IntakeMessage(result), IntakeSections(result), IntakeDetails(result));
}
