#include "CommonRUKTools/Dialogs.h"

#include <algorithm>
#include <cstdio>

#include "CommonRUKTools/Volumes.h"

using namespace Qt::StringLiterals;

namespace {

class SilentDialogs : public Dialogs {
 public:
    void ShowMessage(MessageKind, const QString& text) override {
        std::fprintf(stderr, "%s\n", text.toUtf8().constData());
    }
    int Ask(const Question& question) override {
        std::fprintf(stderr, "%s\n", question.Text.toUtf8().constData());
        return question.Cancel;
    }
    std::optional<QString> Input(const QString&, const QString&, const QStringList&,
                                 const QString&) override {
        return std::nullopt;
    }
    std::optional<QString> OpenFile(const FileDialogOptions&) override { return std::nullopt; }
    QStringList OpenFiles(const FileDialogOptions&) override { return {}; }
    std::optional<QString> SaveFile(const FileDialogOptions&) override { return std::nullopt; }
    std::optional<QString> ChooseFolder(const QString&, const QString&) override { return std::nullopt; }
};

enum Choice { Agree, Decline };

Question Decision(const QString& text, const QString& agree, const QString& decline, ReturnKey returnKey) {
    return {.Text = text,
            .Buttons = {agree, decline},
            .Cancel = Decline,
            .Default = returnKey == ReturnKey::Agrees ? Agree : Decline};
}

Dialogs*& Installed() {
    static Dialogs* dialogs = nullptr;
    return dialogs;
}

}  // namespace

bool Report::HasComplaints() const {
    return std::ranges::any_of(Sections, &ReportSection::Complaint);
}

bool Dialogs::Confirm(const QString& question, const QString& action, ReturnKey returnKey) {
    return Ask(Decision(question, action, u"Abbrechen"_s, returnKey)) == Agree;
}

bool Dialogs::AskYesNo(const QString& question, ReturnKey returnKey) {
    return Ask(Decision(question, u"Ja"_s, u"Nein"_s, returnKey)) == Agree;
}

void Dialogs::ShowReport(const Report& report) {
    constexpr int kOk = 0;
    constexpr int kDetails = 1;
    const int answer = Ask({.Text = report.Message, .Buttons = {u"OK"_s, u"Details"_s}, .Cancel = kOk});
    if (answer == kDetails && report.OpenAsText) report.OpenAsText();
}

std::optional<QString> Dialogs::ChooseVolume(const QString& caption, const QString& prompt,
                                             const QString& preset) {
    const std::vector<VolumeChoice> volumes = VolumeChoices(preset);
    QStringList captions;
    QString chosen;
    for (const VolumeChoice& volume : volumes) {
        captions << volume.Caption;
        if (volume.MountPoint == preset) chosen = volume.Caption;
    }
    const auto answer = Input(caption, prompt, captions, chosen.isEmpty() ? captions.front() : chosen);
    if (!answer) return std::nullopt;
    const auto found = std::ranges::find(volumes, *answer, &VolumeChoice::Caption);
    return found != volumes.end() ? found->MountPoint : QString();
}

Dialogs& UserDialogs() {
    static SilentDialogs silent;
    return Installed() != nullptr ? *Installed() : silent;
}

void SetUserDialogs(Dialogs* dialogs) {
    Installed() = dialogs;
}
