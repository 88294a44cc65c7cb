#include "app/dialogs/QtDialogs.h"

#include <QApplication>
#include <QDir>
#include <QFileDialog>
#include <QInputDialog>
#include <QMessageBox>
#include <QPushButton>
#include <algorithm>
#include <utility>

#include "CommonRUKTools/MusicFolder.h"
#include "CommonRUKTools/Volumes.h"
#include "app/dialogs/FileFilters.h"

using namespace Qt::StringLiterals;

namespace {

constexpr auto kTitle = u"Tunestead";

// The engine's texts are plain, whatever characters a file name brings along, and some come with the line
// ends of another system.
void SetText(QMessageBox& box, QString text) {
    box.setTextFormat(Qt::PlainText);
    box.setText(text.replace(u"\r\n"_s, u"\n"_s));
}

QMessageBox::Icon IconOf(MessageKind kind) {
    switch (kind) {
        case MessageKind::Information:
            return QMessageBox::Information;
        case MessageKind::Warning:
            return QMessageBox::Warning;
        case MessageKind::Error:
            break;
    }
    return QMessageBox::Critical;
}

// Roles let the style arrange the buttons as its desktop does.
QMessageBox::ButtonRole RoleOf(int button, int cancelButton) {
    if (button == cancelButton) return QMessageBox::RejectRole;
    return button == 0 ? QMessageBox::YesRole : QMessageBox::NoRole;
}

// The first letter of each caption that no other before it has taken.
QStringList WithAccessKeys(QStringList captions) {
    QString taken;
    for (QString& caption : captions) {
        caption.replace(u'&', u"&&"_s);
        for (qsizetype i = 0; i < caption.size(); ++i) {
            const QChar letter = caption[i].toLower();
            if (!letter.isLetter() || taken.contains(letter)) continue;
            taken += letter;
            caption.insert(i, u'&');
            break;
        }
    }
    return captions;
}

// Captions are set here and not left to Qt's translation, which may not be installed.
void SetUpFileDialog(QFileDialog& dialog, const QString& accept) {
    dialog.setLabelText(QFileDialog::Accept, accept);
    dialog.setLabelText(QFileDialog::Reject, u"Abbrechen"_s);
    dialog.setLabelText(QFileDialog::FileName, u"Dateiname:"_s);
    dialog.setLabelText(QFileDialog::FileType, u"Dateityp:"_s);
    dialog.setLabelText(QFileDialog::LookIn, u"Suchen in:"_s);
}

void SetUpInput(QInputDialog& dialog, const QString& caption, const QString& prompt) {
    dialog.setWindowTitle(caption);
    dialog.setLabelText(prompt);
    dialog.setOkButtonText(u"OK"_s);
    dialog.setCancelButtonText(u"Abbrechen"_s);
    constexpr int kWidth = 60;  // average characters: room for the caption too
    dialog.resize(kWidth * dialog.fontMetrics().averageCharWidth(), dialog.sizeHint().height());
}

// Songs mostly lie there.
QString UsualFolder() {
    const QString music = MusicFolder();
    return QFileInfo(music).isDir() ? music : QDir::homePath();
}

}  // namespace

QWidget* QtDialogs::Parent() const {
    QWidget* active = QApplication::activeWindow();
    return active != nullptr ? active : mainWindow_.data();
}

void QtDialogs::ApplyOptions(QFileDialog& dialog, const FileDialogOptions& options) const {
    if (!options.Title.isEmpty()) dialog.setWindowTitle(options.Title);
    dialog.setOption(QFileDialog::HideNameFilterDetails);
    const QStringList filters = NameFilters(options.Filter);
    if (!filters.isEmpty()) dialog.setNameFilters(filters);
    if (!options.DefaultExtension.isEmpty()) dialog.setDefaultSuffix(options.DefaultExtension);

    const QFileInfo preset(options.Preset);
    if (options.Preset.isEmpty())
        dialog.setDirectory(folder_.isEmpty() ? UsualFolder() : folder_);
    else
        dialog.setDirectory(preset.isDir() ? preset.absoluteFilePath() : preset.absolutePath());
    if (!options.Preset.isEmpty() && !preset.isDir()) dialog.selectFile(preset.fileName());
}

QStringList QtDialogs::Choose(QFileDialog& dialog) {
    if (dialog.exec() != QDialog::Accepted) return {};
    folder_ = dialog.directory().absolutePath();
    return dialog.selectedFiles();
}

void QtDialogs::ShowMessage(MessageKind kind, const QString& text) {
    QMessageBox box(Parent());
    box.setWindowTitle(QString::fromUtf16(kTitle));
    box.setIcon(IconOf(kind));
    SetText(box, text);
    box.addButton(u"OK"_s, QMessageBox::AcceptRole);
    box.exec();
}

int QtDialogs::Ask(const Question& question) {
    QMessageBox box(Parent());
    box.setWindowTitle(QString::fromUtf16(kTitle));
    box.setIcon(QMessageBox::Question);
    SetText(box, question.Text);
    const QStringList captions = WithAccessKeys(question.Buttons);
    QList<QPushButton*> made;
    for (int i = 0; i < captions.size(); ++i)
        made << box.addButton(captions[i], RoleOf(i, question.Cancel));
    box.setEscapeButton(made.value(question.Cancel));
    box.setDefaultButton(made.value(question.DefaultButton()));
    box.exec();
    const auto chosen = static_cast<int>(made.indexOf(box.clickedButton()));
    return chosen >= 0 ? chosen : question.Cancel;
}

std::optional<QString> QtDialogs::Input(const QString& caption, const QString& prompt,
                                        const QStringList& choices, const QString& preset) {
    QInputDialog dialog(Parent());
    SetUpInput(dialog, caption, prompt);
    if (!choices.isEmpty()) {
        dialog.setComboBoxItems(choices);
        dialog.setComboBoxEditable(false);
    }
    dialog.setTextValue(preset);
    if (dialog.exec() != QDialog::Accepted) return std::nullopt;
    return dialog.textValue();
}

std::optional<QString> QtDialogs::ChooseVolume(const QString& caption, const QString& prompt,
                                               const QString& preset) {
    QInputDialog dialog(Parent());
    SetUpInput(dialog, caption, prompt);
    dialog.setComboBoxEditable(false);
    std::vector<VolumeChoice> shown;
    // What has come is what the user has just plugged in.
    const auto show = [&](const QString& chosen) {
        const std::vector<VolumeChoice> before = std::exchange(shown, VolumeChoices(preset));
        QStringList captions;
        QString selected;
        QString come;
        for (const VolumeChoice& volume : shown) {
            captions << volume.Caption;
            const bool isNew =
                std::ranges::find(before, volume.MountPoint, &VolumeChoice::MountPoint) == before.end();
            if (volume.MountPoint == chosen) selected = volume.Caption;
            if (isNew && !before.empty()) come = volume.Caption;
        }
        if (!come.isEmpty()) selected = come;
        dialog.setComboBoxItems(captions);
        dialog.setTextValue(selected.isEmpty() ? captions.front() : selected);
    };
    const auto chosen = [&] {
        const auto found = std::ranges::find(shown, dialog.textValue(), &VolumeChoice::Caption);
        return found != shown.end() ? found->MountPoint : QString();
    };
    show(preset);
    const Subscription changes = CurrentVolumes().Changed.Subscribe([&] { show(chosen()); });
    if (dialog.exec() != QDialog::Accepted) return std::nullopt;
    return chosen();
}

std::optional<QString> QtDialogs::OpenFile(const FileDialogOptions& options) {
    QFileDialog dialog(Parent());
    dialog.setFileMode(QFileDialog::ExistingFile);
    SetUpFileDialog(dialog, u"Öffnen"_s);
    ApplyOptions(dialog, options);
    const QStringList files = Choose(dialog);
    return files.isEmpty() ? std::nullopt : std::optional(files.first());
}

QStringList QtDialogs::OpenFiles(const FileDialogOptions& options) {
    QFileDialog dialog(Parent());
    dialog.setFileMode(QFileDialog::ExistingFiles);
    SetUpFileDialog(dialog, u"Öffnen"_s);
    ApplyOptions(dialog, options);
    return Choose(dialog);
}

std::optional<QString> QtDialogs::SaveFile(const FileDialogOptions& options) {
    QFileDialog dialog(Parent());
    dialog.setAcceptMode(QFileDialog::AcceptSave);
    dialog.setFileMode(QFileDialog::AnyFile);
    dialog.setOption(QFileDialog::DontConfirmOverwrite);  // asked below, with buttons of our own
    SetUpFileDialog(dialog, u"Speichern"_s);
    ApplyOptions(dialog, options);
    for (;;) {
        const QStringList files = Choose(dialog);
        if (files.isEmpty()) return std::nullopt;
        if (!options.ConfirmOverwrite || !QFileInfo::exists(files.first())) return files.first();
        const QString question = u"Die Datei "_s + QDir::toNativeSeparators(files.first()) +
                                 u" ist schon vorhanden. Soll sie ersetzt werden?"_s;
        if (Confirm(question, u"Ersetzen"_s)) return files.first();
    }
}

std::optional<QString> QtDialogs::ChooseFolder(const QString& caption, const QString& startFolder) {
    QFileDialog dialog(Parent(), caption);
    dialog.setFileMode(QFileDialog::Directory);
    dialog.setOption(QFileDialog::ShowDirsOnly);
    SetUpFileDialog(dialog, u"Auswählen"_s);
    FileDialogOptions options;
    options.Preset = startFolder;
    ApplyOptions(dialog, options);
    dialog.setLabelText(QFileDialog::FileName, u"Ordner:"_s);
    const QStringList folders = Choose(dialog);
    return folders.isEmpty() ? std::nullopt : std::optional(folders.first());
}
