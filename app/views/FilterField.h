#pragma once

#include <QTimer>
#include <QWidget>
#include <functional>

class FilteredSongs;
class QLabel;
class QLineEdit;

// The line above the song list that narrows it while the user types, and says how many songs are left and
// what of it is not understood.
class FilterField : public QWidget {
 public:
    explicit FilterField(FilteredSongs& songs, QWidget* parent = nullptr);
    ~FilterField() override;

    // The user goes on to the list.
    std::function<void()> OnLeave;

    // Puts the focus into the line and selects its text.
    void Activate();
    // What is being looked for: the text of the line, or when it is empty again what was last looked for.
    QString SearchText() const;

 protected:
    bool eventFilter(QObject* watched, QEvent* event) override;

 private:
    void SetUpEdit();
    void FollowSongs();
    void TextChanged();
    void Apply();
    void Remember();
    void Leave();
    void ShowCount();
    void ShowWarning();

    FilteredSongs& songs_;
    QLineEdit* edit_;
    QLabel* count_;
    QLabel* warning_;
    QTimer pause_;
    QString lastText_;
};
