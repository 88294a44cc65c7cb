#include "app/models/CoverPictures.h"

#include <QBuffer>
#include <QFile>
#include <QFileInfo>
#include <QImage>
#include <QImageReader>
#include <QLocale>
#include <QMimeData>
#include <QUrl>

#include "CommonRUKTools/Errors.h"
#include "app/models/CoverImage.h"

using namespace Qt::StringLiterals;

namespace {

// Readers look for a cover within the first 16 MiB of a tag.
constexpr qint64 kMostBytes = 10 * 1024 * 1024;
// A pasted picture without transparency that would be larger becomes a JPEG.
constexpr qsizetype kLargePng = 1024 * 1024;
constexpr int kJpegQuality = 92;

const QString kPng = u"image/png"_s;
const QString kJpeg = u"image/jpeg"_s;

// Empty for anything else.
QString TypeOf(const QByteArray& bytes) {
    if (bytes.startsWith("\x89PNG\r\n\x1a\n")) return kPng;
    return bytes.startsWith("\xff\xd8\xff") ? kJpeg : QString();
}

void RefuseLarge(qint64 size) {
    if (size > kMostBytes) throw ERukException(u"Das Bild ist zu groß: höchstens 10 MB."_s);
}

QByteArray Encoded(const QImage& image) {
    const auto encode = [&image](const char* format, int quality) {
        QByteArray bytes;
        QBuffer buffer(&bytes);
        image.save(&buffer, format, quality);
        return bytes;
    };
    const QByteArray png = encode("PNG", -1);
    return png.size() <= kLargePng || image.hasAlphaChannel() ? png : encode("JPEG", kJpegQuality);
}

QString LocalPicture(const QMimeData& data) {
    for (const QUrl& url : data.urls()) {
        const QString suffix = QFileInfo(url.toLocalFile()).suffix().toLower();
        if (suffix == u"png"_s || suffix == u"jpg"_s || suffix == u"jpeg"_s) return url.toLocalFile();
    }
    return {};
}

}  // namespace

CoverPicture PictureOf(const QByteArray& bytes) {
    RefuseLarge(bytes.size());
    const QString type = TypeOf(bytes);
    if (type.isEmpty()) throw ERukException(u"Ein Cover muss ein Bild im Format PNG oder JPEG sein."_s);
    if (DecodeCover(bytes).isNull()) throw ERukException(u"Das Bild ist beschädigt oder zu groß."_s);
    return {bytes, type};
}

CoverPicture ReadPicture(const QString& path) {
    QFile file(path);
    if (!file.open(QIODevice::ReadOnly))
        throw ERukException(u"Kann die Datei %1 nicht lesen: %2"_s.arg(path, file.errorString()));
    RefuseLarge(file.size());
    return PictureOf(file.readAll());
}

bool MayHoldPicture(const QMimeData& data) {
    return data.hasImage() || data.hasFormat(kPng) || data.hasFormat(kJpeg) || !LocalPicture(data).isEmpty();
}

CoverPicture PictureFrom(const QMimeData& data) {
    const QString path = LocalPicture(data);
    if (!path.isEmpty()) return ReadPicture(path);
    for (const QString& type : {kPng, kJpeg})
        if (const QByteArray bytes = data.data(type); !bytes.isEmpty()) return PictureOf(bytes);
    const auto image = qvariant_cast<QImage>(data.imageData());
    if (image.isNull()) throw ERukException(u"Die Zwischenablage enthält kein Bild."_s);
    return PictureOf(Encoded(image));
}

QString DescribePicture(const QByteArray& bytes) {
    QBuffer buffer;
    buffer.setData(bytes);
    buffer.open(QIODevice::ReadOnly);
    QImageReader reader(&buffer);
    reader.setDecideFormatFromContent(true);
    QStringList parts;
    if (reader.canRead()) {
        parts << QString::fromLatin1(reader.format()).toUpper();
        if (const QSize size = reader.size(); size.isValid())
            parts << u"%1 × %2 Pixel"_s.arg(size.width()).arg(size.height());
    }
    parts << QLocale(QLocale::German).formattedDataSize(bytes.size(), 0, QLocale::DataSizeTraditionalFormat);
    return parts.join(u", "_s);
}

QString SuffixOfPicture(const QByteArray& bytes) {
    const QString type = TypeOf(bytes);
    if (type == kPng) return u"png"_s;
    return type == kJpeg ? u"jpg"_s : u"bild"_s;
}
