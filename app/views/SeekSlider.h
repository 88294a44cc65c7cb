#pragma once

#include <QSlider>
#include <functional>

// Shows how far a song has played, in milliseconds, and lets the user go to another place: by a click, by
// dragging (goes there when let go) and by keys.
class SeekSlider : public QSlider {
 public:
    explicit SeekSlider(QWidget* parent = nullptr);

    // Where the user wants to go.
    std::function<void(int position)> OnSeek;
    // What the user aims at while dragging.
    std::function<void(int position)> OnDrag;

    // Without a length the slider rests.
    void ShowPosition(int position, int length);
    bool IsDragging() const { return dragging_; }

 protected:
    void mousePressEvent(QMouseEvent* event) override;
    void mouseMoveEvent(QMouseEvent* event) override;
    void mouseReleaseEvent(QMouseEvent* event) override;
    void wheelEvent(QWheelEvent* event) override;
    void keyPressEvent(QKeyEvent* event) override;

 private:
    int PositionAt(int x) const;
    void Seek(int position);

    bool dragging_ = false;
};
