#pragma once

#include <QLabel>

// A line of plain text that is shortened in its middle where it does not fit, so that a long path does not
// widen its window.
class ElidedLabel : public QLabel {
 public:
    explicit ElidedLabel(QWidget* parent = nullptr);

    QSize sizeHint() const override;
    QSize minimumSizeHint() const override { return sizeHint(); }

 protected:
    void paintEvent(QPaintEvent* event) override;
};
