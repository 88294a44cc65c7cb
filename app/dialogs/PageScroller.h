#pragma once

#include <QScrollArea>

// Scrolls a sheet of fields up and down where the window is too low for it. It is never narrower than the
// sheet, so nothing is cut off at the side, whatever the font.
class PageScroller : public QScrollArea {
 public:
    explicit PageScroller(QWidget* sheet, QWidget* parent = nullptr);
    ~PageScroller() override;

    QSize sizeHint() const override;
    QSize minimumSizeHint() const override;

 protected:
    bool event(QEvent* event) override;

 private:
    int FrameWidth() const;
    void ShowField(QWidget* field);
};
