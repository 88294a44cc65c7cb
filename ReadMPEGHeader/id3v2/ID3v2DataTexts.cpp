#include "ReadMPEGHeader/id3v2/ID3v2DataTexts.h"

#include <QStringList>
#include <array>

#include "ReadMPEGHeader/id3v2/PictureType.h"

using namespace Qt::StringLiterals;

namespace {

qint64 SizeOf(const FrameBody& body) {
    return static_cast<qint64>(body.Size());
}

FrameText Present(qint64 count, const QString& unit) {
    return {u"Vorhanden (%1 %2)"_s.arg(count).arg(unit), count};
}

FrameText PresentEntries(qint64 count) {
    return Present(count, count == 1 ? u"Eintrag"_s : u"Einträge"_s);
}

QString Joined(QStringList parts) {
    parts.removeAll(QString());
    return parts.join(u", ");
}

// "20020131" as "31.01.2002"; anything else as it stands.
QString GermanDate(const QString& date) {
    if (date.size() != 8) return date;
    return u"%1.%2.%3"_s.arg(date.right(2), date.mid(4, 2), date.left(4));
}

QString TimeUnit(int unit) {
    switch (unit) {
        case 1:
            return u"MPEG Frames"_s;
        case 2:
            return u"Millisekunden"_s;
        default:
            return u"unbek. Einheiten"_s;
    }
}

// How goods are delivered, numbers 0 to 8 of a "COMR" frame (https://id3.org/id3v2.3.0#COMR).
constexpr std::array<const char16_t*, 9> kDeliveries = {
    u"Sonstiges",
    u"CD-Album",
    u"komprimiert auf CD",
    u"Datei aus dem Internet",
    u"Stream im Internet",
    u"Notenblätter",
    u"Notenblätter in einem Buch",
    u"Musik auf anderen Medien",
    u"Waren, die keine Musik sind",
};

QString DeliveryText(std::size_t delivery) {
    return delivery < kDeliveries.size() ? QString::fromUtf16(kDeliveries[delivery]) : u"unbekannt"_s;
}

FrameText DescribePicture(FrameBody& body, const QString& format) {
    const QString type = PictureTypeText(body.U8());
    const QString description = body.Text();
    return {Joined({type, format, description}), static_cast<qint64>(body.Remaining())};
}

}  // namespace

FrameText BinarySizeText(FrameBody& body) {
    return {u"%1 Byte bin"_s.arg(SizeOf(body)), SizeOf(body)};
}

FrameText StoredSizeText(FrameBody& body) {
    return Present(SizeOf(body), u"Byte"_s);
}

FrameText EventTimesText(FrameBody& body) {
    constexpr qint64 kEntrySize = 5;  // kind and time
    body.Skip(1);                     // unit of the times
    return PresentEntries(static_cast<qint64>(body.Remaining()) / kEntrySize);
}

FrameText TempoCodesText(FrameBody& body) {
    const QString unit = TimeUnit(body.U8());
    return {u"Vorhanden (%1 Byte, %2)"_s.arg(SizeOf(body)).arg(unit), SizeOf(body)};
}

FrameText PositionText(FrameBody& body) {
    const QString unit = TimeUnit(body.U8());
    const qint64 position = body.Counter();
    return {u"%1 %2"_s.arg(position).arg(unit), position};
}

FrameText VolumeText(FrameBody& body) {
    const std::uint8_t increments = body.U8();  // bit 0 right, bit 1 left
    const int bits = body.U8();
    const std::size_t bytes = static_cast<std::size_t>(bits + 7) / 8;
    if (bytes == 0 || bytes > 4 || body.Remaining() < 2 * bytes) return StoredSizeText(body);
    const QString right = (increments & 1) != 0 ? u"+"_s : u"-"_s;
    const QString left = (increments & 2) != 0 ? u"+"_s : u"-"_s;
    const qint64 rightChange = body.Number(bytes);
    const qint64 leftChange = body.Number(bytes);
    return {u"Lautstärke links %1%2, rechts %3%4 (%5 Bit)"_s.arg(left)
                .arg(leftChange)
                .arg(right)
                .arg(rightChange)
                .arg(bits)};
}

FrameText EqualisationText(FrameBody& body) {
    const std::size_t bytes = static_cast<std::size_t>(body.U8() + 7) / 8;
    const std::size_t entrySize = 2 + bytes;  // direction and frequency, adjustment
    return PresentEntries(static_cast<qint64>(body.Remaining() / entrySize));
}

FrameText ReverbText(FrameBody& body) {
    const int left = body.U16();
    const int right = body.U16();
    return {u"Hall links %1 ms, rechts %2 ms"_s.arg(left).arg(right)};
}

FrameText BufferText(FrameBody& body) {
    const qint64 size = body.U24();
    return {u"Empfohlener Puffer: %1 Byte"_s.arg(size), size};
}

FrameText PlayCounterText(FrameBody& body) {
    const qint64 count = body.Counter();
    return {u"%1 mal gespielt"_s.arg(count), count};
}

FrameText PopularityText(FrameBody& body) {
    const QString user = body.Latin();
    const int rating = body.U8();
    const qint64 count = body.Counter();
    return {Joined({user, u"Wertung %1 von 255"_s.arg(rating), u"%1 mal gespielt"_s.arg(count)}), count};
}

FrameText PictureText(FrameBody& body) {
    body.ReadEncoding();
    const QString format = body.Latin();
    return DescribePicture(body, format);
}

FrameText OldPictureText(FrameBody& body) {
    body.ReadEncoding();
    const QString format = body.Latin(3);
    return DescribePicture(body, format);
}

FrameText ObjectText(FrameBody& body) {
    body.ReadEncoding();
    const QString format = body.Latin();
    const QString fileName = body.Text();
    const QString description = body.Text();
    const auto size = static_cast<qint64>(body.Remaining());
    return {Joined({fileName, description, format, u"%1 Byte"_s.arg(size)}), size};
}

FrameText EncryptionText(FrameBody& body) {
    return {u"Verschlüsselt: %1"_s.arg(body.Latin())};
}

FrameText LinkText(FrameBody& body) {
    const QString frame = body.Latin(4);
    const QString url = body.Latin();
    return {u"%1 %2 ID:%3"_s.arg(frame, url, body.Latin())};
}

FrameText OwnershipText(FrameBody& body) {
    body.ReadEncoding();
    const QString price = body.Latin();
    const QString date = GermanDate(body.Latin(8));
    const QString seller = body.Text();
    return {Joined({u"Bezahlter Preis: "_s + price, u"Datum: "_s + date, seller})};
}

FrameText CommercialText(FrameBody& body) {
    body.ReadEncoding();
    const QString price = body.Latin();
    const QString validUntil = GermanDate(body.Latin(8));
    const QString contact = body.Latin();
    const QString delivery = DeliveryText(body.U8());
    const QString seller = body.Text();
    const QString description = body.Text();
    return {Joined({u"Preis: "_s + price, u"gültig bis "_s + validUntil, u"als: "_s + delivery, seller,
                    description, contact})};
}
