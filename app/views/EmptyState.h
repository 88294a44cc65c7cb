#pragma once

#include <QWidget>
#include <functional>

class QLabel;
class QPushButton;

// Stands in the song list's place while there are no songs, and says how to get some.
class EmptyState : public QWidget {
 public:
    explicit EmptyState(QWidget* parent = nullptr);

    std::function<void()> OnAddSongs;
    std::function<void()> OnAddFolder;

    void SetCommandsEnabled(bool enabled);
    // Shows that what hovers over the window may be dropped.
    void SetDropMark(bool marked);

 protected:
    void paintEvent(QPaintEvent* event) override;

 private:
    QPushButton* MakeButton(const QString& text, const QIcon& icon, std::function<void()> EmptyState::*event);

    QPushButton* addFolder_;
    QPushButton* addSongs_;
    bool dropMark_ = false;
};
