#pragma once

#include <QWidget>
#include <functional>

class QLabel;
class QLineEdit;
class QPushButton;

// Edits a pattern for file names: the place-holders can be picked from a menu, and a line below shows what
// comes of it, as a rule by an example.
class NamePatternEdit : public QWidget {
 public:
    // What is said of a pattern.
    using Description = std::function<QString(const QString& pattern)>;

    explicit NamePatternEdit(QWidget* parent = nullptr);

    QString Pattern() const;
    void SetPattern(const QString& pattern);
    void SetDescription(Description description);
    QLineEdit& Edit() const { return *edit_; }

 private:
    void AddPlaceholders();
    void ShowDescription();

    QLineEdit* edit_;
    QPushButton* insert_;
    QLabel* shown_;
    Description description_;
};
