#include "cli/TerminalDialogs.h"

#include <QFileInfo>
#include <array>

#include "CommonRUKTools/ByteReader.h"
#include "CommonRUKTools/CodePage.h"

using namespace Qt::StringLiterals;

void TerminalDialogs::Print(const QString& text) {
    std::fputs(text.toUtf8().constData(), questions_);
    std::fflush(questions_);
}

std::optional<QString> TerminalDialogs::ReadLine(const QString& prompt) {
    Print(prompt);
    if (answers_ == nullptr) {
        Print(u"\n"_s);
        return std::nullopt;
    }
    QByteArray line;
    std::array<char, 512> part{};
    while (!line.endsWith('\n') &&
           std::fgets(part.data(), static_cast<int>(part.size()), answers_) != nullptr)
        line += part.data();
    if (line.isEmpty()) return std::nullopt;
    while (line.endsWith('\n') || line.endsWith('\r'))
        line.chop(1);
    return CodePage::FromSystem(AsBytes({line.constData(), static_cast<std::size_t>(line.size())}));
}

std::optional<int> TerminalDialogs::Choose(const QStringList& choices, const QString& prompt,
                                           std::optional<int> preset) {
    for (qsizetype i = 0; i < choices.size(); ++i)
        Print(u"  %1) %2\n"_s.arg(i + 1).arg(choices[i]));
    const QString hint = preset ? u" [%1]"_s.arg(*preset + 1) : QString();
    const auto answer = ReadLine(prompt + hint + u": "_s);
    if (answer && answer->isEmpty()) return preset;
    const int number = answer ? answer->toInt() : 0;
    return number >= 1 && number <= choices.size() ? std::optional<int>(number - 1) : std::nullopt;
}

std::optional<QString> TerminalDialogs::AskForPath(const QString& caption, const QString& preset) {
    const QString hint = preset.isEmpty() ? QString() : u" ["_s + preset + u']';
    const auto path = ReadLine(caption + hint + u": "_s);
    if (!path) return std::nullopt;
    const QString chosen = path->isEmpty() ? preset : *path;
    return chosen.isEmpty() ? std::nullopt : std::optional<QString>(chosen);
}

void TerminalDialogs::ShowMessage(MessageKind, const QString& text) {
    Print(text + u'\n');
}

int TerminalDialogs::Ask(const Question& question) {
    Print(question.Text + u'\n');
    return Choose(question.Buttons, u"Auswahl"_s, question.DefaultButton()).value_or(question.Cancel);
}

std::optional<QString> TerminalDialogs::Input(const QString& caption, const QString& prompt,
                                              const QStringList& choices, const QString& preset) {
    Print(caption + u'\n');
    if (choices.isEmpty()) return AskForPath(prompt, preset);
    const auto choice = Choose(choices, prompt);
    return choice ? std::optional<QString>(choices[*choice]) : std::nullopt;
}

std::optional<QString> TerminalDialogs::OpenFile(const FileDialogOptions& options) {
    return AskForPath(options.Title, options.Preset);
}

QStringList TerminalDialogs::OpenFiles(const FileDialogOptions& options) {
    const auto path = AskForPath(options.Title, options.Preset);
    return path ? QStringList{*path} : QStringList();
}

std::optional<QString> TerminalDialogs::SaveFile(const FileDialogOptions& options) {
    auto path = AskForPath(options.Title, options.Preset);
    if (!path || !options.ConfirmOverwrite || !QFileInfo::exists(*path)) return path;
    return AskYesNo(*path + u" überschreiben?"_s) ? path : std::nullopt;
}

std::optional<QString> TerminalDialogs::ChooseFolder(const QString& caption, const QString& startFolder) {
    return AskForPath(caption, startFolder);
}
