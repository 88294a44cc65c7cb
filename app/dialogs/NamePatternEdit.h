#pragma once

#include <QWidget>
#include <functional>

class QLabel;
class QLineEdit;
class QPushButton;

// Edits a pattern for file names: the place-holders can be picked from a menu, and an example shows what
// comes of it.
class NamePatternEdit : public QWidget {
 public:
    explicit NamePatternEdit(QWidget* parent = nullptr);

    QString Pattern() const;
    void SetPattern(const QString& pattern);
    QLineEdit& Edit() const { return *edit_; }

 private:
    void AddPlaceholders();
    void ShowExample();

    QLineEdit* edit_;
    QPushButton* insert_;
    QLabel* example_;
};
