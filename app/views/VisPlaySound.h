#pragma once

#include <QWidget>

#include "MusicManagment/playback/PlaySound.h"
#include "app/models/PlayingSong.h"

class ElidedLabel;
class QBoxLayout;
class QComboBox;
class QLabel;
class QToolButton;
class SeekSlider;
class VolumeSlider;

// The player's panel: the song, how far it has played, the buttons, and when songs are faded into each other.
// In a wide window all that is one strip, in a narrow one it stands one above the other.
class TVisPlaySound : public QWidget, public PlayerPanel {
 public:
    TVisPlaySound(TPlaySound& player, const TPlayList& list, QWidget* parent = nullptr);
    ~TVisPlaySound() override;

    const PlayingSong& Song() const { return song_; }
    VolumeSlider& Volume() { return *volume_; }
    QSize minimumSizeHint() const override;

    void ShowSong(const QString& fileName) override;
    void Clear() override;
    void ShowPosition(quint32 position, quint32 length) override;
    void Redraw() override;
    TCrossover Crossover() const override;
    void SetCrossover(TCrossover mode) override;

 protected:
    void resizeEvent(QResizeEvent* event) override;
    void changeEvent(QEvent* event) override;

 private:
    QToolButton* AddButton(QBoxLayout& row, int command, const QString& caption);
    QWidget* MakeButtons();
    QWidget* MakeSong();
    void SetUpSlider();
    void SetUpCrossover();
    void Arrange();
    void FitToFont();
    void ShowTexts();
    void ShowState();
    void ShowTimes(quint32 position);
    QString EngineText() const;

    TPlaySound& player_;
    const TPlayList& list_;
    PlayingSong song_;
    quint32 length_ = 0;  // ms
    QBoxLayout* layout_;
    ElidedLabel* title_;
    ElidedLabel* artist_;
    SeekSlider* slider_;
    QLabel* elapsed_;
    QLabel* remaining_;
    QWidget* buttons_ = nullptr;
    QToolButton* play_ = nullptr;
    QToolButton* stop_ = nullptr;
    QToolButton* previous_ = nullptr;
    QToolButton* next_ = nullptr;
    VolumeSlider* volume_;
    QComboBox* crossover_;
};
