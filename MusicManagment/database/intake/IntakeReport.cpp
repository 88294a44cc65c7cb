#include "MusicManagment/database/intake/IntakeReport.h"

#include <QDir>
#include <QFile>

#include "CommonRUKTools/CodePage.h"
#include "CommonRUKTools/Shell.h"

using namespace Qt::StringLiterals;

namespace {

void AppendLines(const QStringList& lines, QString& text) {
    for (const QString& line : lines)
        text += line + u'\n';
}

bool WriteDetails(const QString& path, const QString& details) {
    QFile file(path);
    const QByteArray bytes = CodePage::ToSystem(details);
    return file.open(QIODevice::WriteOnly | QIODevice::Text) && file.write(bytes) == bytes.size() &&
           file.flush();
}

void ShowDetails(const QString& details) {
    const QString path = QDir::temp().filePath(u"Tunestead - Änderungen in der Datenbank.txt"_s);
    if (!WriteDetails(path, details))
        UserDialogs().ShowMessage(MessageKind::Error, u"Kann die Datei nicht schreiben: "_s + path);
    else if (!CurrentShell().OpenWithDefaultProgram(path))
        UserDialogs().ShowMessage(MessageKind::Error, u"Kann die Datei nicht anzeigen: "_s + path);
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
    if (result.Unreadable == 0) return text;
    text += u"\nNicht gelesen werden konnte(n) ("_s + QString::number(result.Unreadable) + u"):\n"_s;
    AppendLines(result.UnreadableNames, text);
    return text;
}

std::vector<ReportSection> IntakeSections(const IntakeResult& result) {
    return {{u"Neu aufgenommen"_s, result.NewFiles},
            {u"Nicht gelesen oder nicht aufgenommen"_s, result.UnreadableNames, true}};
}

void ShowReport(const QString& message, std::vector<ReportSection> sections, const QString& details) {
    std::erase_if(sections, [](const ReportSection& section) { return section.Lines.isEmpty(); });
    UserDialogs().ShowReport({message, std::move(sections), [details] { ShowDetails(details); }});
}

void ReportIntake(const IntakeResult& result) {
    ShowReport(IntakeMessage(result), IntakeSections(result), IntakeDetails(result));
}
