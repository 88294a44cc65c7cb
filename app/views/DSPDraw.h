#pragma once

#include <QImage>
#include <QWidget>
#include <mutex>
#include <optional>
#include <stop_token>
#include <thread>

#include "MusicManagment/playback/spectrum/SpectrumCollector.h"
#include "app/views/SpectrumPainter.h"

// Draws the spectrum of what sounds. One thread collects, another one draws; both run only while this can be
// seen.
class TDSPDraw : public QWidget {
 public:
    // Draws what the block with this key tells.
    explicit TDSPDraw(const QString& key, QWidget* parent = nullptr);
    explicit TDSPDraw(QWidget* parent = nullptr);
    ~TDSPDraw() override;

    // Told when drawing begins and ends.
    std::function<void(bool)> OnDrawing;

    TSpectrumStyle Style() const { return style_; }
    void SetStyle(TSpectrumStyle style);
    bool IsDrawing() const { return drawing_.joinable(); }
    // Pictures since the first one.
    int Frames() const { return frames_; }

    QSize sizeHint() const override;
    QSize minimumSizeHint() const override;

 protected:
    void showEvent(QShowEvent* event) override;
    void hideEvent(QHideEvent* event) override;
    void resizeEvent(QResizeEvent* event) override;
    void changeEvent(QEvent* event) override;
    void paintEvent(QPaintEvent* event) override;

 private:
    // What the drawing thread has to know of the widget.
    struct Canvas {
        QSize Size;  // in the widget's own pixels
        qreal Ratio = 1;
        TSpectrumStyle Style = ssBars;
        SpectrumColors Colors;
    };

    void SetUp();
    void Start();
    void Stop();
    SpectrumColors Colors() const;
    void TellCanvas();
    void DrawAgain();
    void Run(const std::stop_token& stop);
    QImage Draw(const SpectrumColumns& columns);
    void HandOver(QImage picture);
    void ShowNext();

    SpectrumCollector collector_;
    TSpectrumStyle style_ = ssBars;
    QImage picture_;
    int frames_ = 0;
    std::mutex mutex_;
    Canvas canvas_;               // under the mutex, as is the next one
    std::optional<QImage> next_;  // drawn, and not shown yet
    std::jthread drawing_;        // ends before the rest goes
};
