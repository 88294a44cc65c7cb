#include "app/models/CoverImage.h"

#include <QBuffer>
#include <QImageReader>

using namespace Qt::StringLiterals;

namespace {

constexpr int kLongestEdge = 600;                       // pixels, of what is shown
constexpr qint64 kMostPixels = qint64{48} * 1'000'000;  // of what is decoded

// The others are drawings and containers that nobody puts into a tag, and more to go wrong.
bool IsPhotographFormat(const QByteArray& format) {
    return format == "jpeg" || format == "png" || format == "gif" || format == "bmp" || format == "webp";
}

}  // namespace

QImage DecodeCover(const QByteArray& bytes) {
    QBuffer buffer;
    buffer.setData(bytes);
    buffer.open(QIODevice::ReadOnly);
    QImageReader reader(&buffer);
    reader.setDecideFormatFromContent(true);
    reader.setAutoTransform(true);
    if (!reader.canRead() || !IsPhotographFormat(reader.format())) return {};
    const QSize size = reader.size();
    if (size.isEmpty() || qint64{size.width()} * size.height() > kMostPixels) return {};
    if (std::max(size.width(), size.height()) > kLongestEdge)
        reader.setScaledSize(
            size.scaled(kLongestEdge, kLongestEdge, Qt::KeepAspectRatio).expandedTo(QSize(1, 1)));
    return reader.read();
}
