#pragma once

#include <QWidget>

#include "CommonRUKTools/Dialogs.h"
#include "MusicManagment/playback/PlaySound.h"

class QLabel;

// The small window of the player program: the song, how far it is, and three buttons. Messages stand in it as
// well: a box that waits for the user would keep the program that drives the player waiting.
class PlayerWindow : public QWidget, public PlayerPanel, public Dialogs {
 public:
    // The player must outlive the window.
    explicit PlayerWindow(TPlaySound& player);
    ~PlayerWindow() override;

    // PlayerPanel
    void ShowSong(const QString& fileName) override;
    void Clear() override;
    void ShowPosition(quint32 position, quint32 length) override;
    void Redraw() override;
    TCrossover Crossover() const override { return crossover_; }
    void SetCrossover(TCrossover mode) override { crossover_ = mode; }

    // Dialogs: a message brings the window to light; whatever is asked is cancelled.
    void ShowMessage(MessageKind kind, const QString& text) override;
    int Ask(const Question& question) override;
    std::optional<QString> Input(const QString& caption, const QString& prompt, const QStringList& choices,
                                 const QString& preset) override;
    std::optional<QString> OpenFile(const FileDialogOptions& options) override;
    QStringList OpenFiles(const FileDialogOptions& options) override;
    std::optional<QString> SaveFile(const FileDialogOptions& options) override;
    std::optional<QString> ChooseFolder(const QString& caption, const QString& startFolder) override;

 private:
    QWidget* Buttons();
    void AddButton(QWidget& row, const QString& caption, const char* icon, void (TPlaySound::*operation)());

    TPlaySound& player_;
    QLabel* song_;
    QLabel* position_;
    QLabel* message_;
    TCrossover crossover_ = coAutoChange;
};
