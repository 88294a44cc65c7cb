#include "CommonRUKTools/Dialogs.h"

#include <cstdio>

namespace {

class SilentDialogs : public Dialogs {
 public:
    void ShowMessage(MessageKind, const QString& text) override {
        std::fprintf(stderr, "%s\n", text.toUtf8().constData());
    }
    int Ask(const QString& text, const QStringList&, int cancelButton) override {
        std::fprintf(stderr, "%s\n", text.toUtf8().constData());
        return cancelButton;
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

Dialogs*& Installed() {
    static Dialogs* dialogs = nullptr;
    return dialogs;
}

}  // namespace

Dialogs& UserDialogs() {
    static SilentDialogs silent;
    return Installed() != nullptr ? *Installed() : silent;
}

void SetUserDialogs(Dialogs* dialogs) {
    Installed() = dialogs;
}
