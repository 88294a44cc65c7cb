#pragma once

#include <QByteArray>
#include <QString>
#include <optional>

// What goes over the channel between a player program and the one that drives it.
enum class FrameKind : quint8 {
    Greeting,      // the first of each side: number = its own number among the peers
    Command,       // code and number; answered
    Text,          // code and text; answered
    Feedback,      // code and number
    FeedbackText,  // code and text
    Question,      // code and number; answered
    Answer,        // number; id is that of what is answered
};

struct Frame {
    FrameKind Kind = FrameKind::Greeting;
    quint32 Id = 0;  // of what is to be answered
    qint32 Code = 0;
    qint64 Number = 0;
    QString Text{};

    bool operator==(const Frame&) const = default;
};

// The longest text, in bytes of UTF-8; longer ones are cut when they are sent.
inline constexpr qsizetype kLongestText = 65536;

QByteArray Encode(const Frame& frame);

// Takes frames out of a stream of bytes, as they come in.
class FrameReader {
 public:
    void Append(const QByteArray& bytes);
    // The next whole frame. Nothing when more bytes are needed, or the stream is broken.
    std::optional<Frame> Next();
    // Once bytes have come that are no frame: what follows cannot be understood.
    bool Broken() const { return broken_; }

 private:
    QByteArray bytes_;
    bool broken_ = false;
};
