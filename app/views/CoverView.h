#pragma once

#include <QImage>
#include <QWidget>

// Shows a picture as large as fits; without one it takes no room.
class CoverView : public QWidget {
 public:
    explicit CoverView(QWidget* parent = nullptr);

    void SetImage(const QImage& image);
    const QImage& Image() const { return image_; }

    QSize sizeHint() const override;
    QSize minimumSizeHint() const override { return {0, sizeHint().height()}; }

 protected:
    void paintEvent(QPaintEvent* event) override;

 private:
    QImage image_;
};
