#pragma once

#include <QByteArray>
#include <QString>
#include <algorithm>
#include <utility>
#include <vector>

#include "CommonRUKTools/ByteWriter.h"

// Builds the header of a WMA file object by object.
class AsfBuilder {
 public:
    // An identifier in its usual spelling: "75B22630-668E-11CF-A6D9-00AA0062CE6C".
    static std::vector<std::uint8_t> Guid(const char* text) {
        const QByteArray hex = QByteArray::fromHex(QByteArray(text).replace('-', ""));
        std::vector<std::uint8_t> bytes(hex.begin(), hex.end());
        std::reverse(bytes.begin(), bytes.begin() + 4);
        std::swap(bytes[4], bytes[5]);
        std::swap(bytes[6], bytes[7]);
        return bytes;
    }

    static std::vector<std::uint8_t> Utf16(const QString& text) {
        ByteWriter bytes;
        for (const QChar c : text + QChar(u'\0'))
            bytes.U16Le(c.unicode());
        return bytes.Bytes();
    }

    // `size` 0: the true one.
    static std::vector<std::uint8_t> Object(const char* guid, const ByteWriter& body,
                                            std::uint64_t size = 0) {
        ByteWriter object;
        object.Raw(Guid(guid));
        object.U64Le(size != 0 ? size : 24 + body.Size());
        object.Raw(body.Bytes());
        return object.Bytes();
    }

    static constexpr const char* kContent = "75B22633-668E-11CF-A6D9-00AA0062CE6C";
    static constexpr const char* kExtendedContent = "D2D0A440-E307-11D2-97F0-00A0C95EA850";
    static constexpr const char* kFileProperties = "8CABDCA1-A947-11CF-8EE4-00C00C205365";
    static constexpr const char* kStreamProperties = "B7DC0791-A9B7-11CF-8EE6-00C00C205365";
    static constexpr const char* kCodecList = "86D15240-311D-11D0-A3A4-00A0C90348F6";
    static constexpr const char* kHeaderExtension = "5FBF03B5-A92E-11CF-8EE3-00C00C205365";
    static constexpr const char* kMetadataLibrary = "44231C94-9498-49D1-A141-1D134E457054";
    static constexpr const char* kAudio = "F8699E40-5B4D-11CF-A8FD-00805F5C442B";
    static constexpr const char* kVideo = "BC19EFC0-5B4D-11CF-A8FD-00805F5C442B";

    AsfBuilder& Add(const std::vector<std::uint8_t>& object) {
        objects_.Raw(object);
        ++count_;
        return *this;
    }

    AsfBuilder& Content(const QString& title, const QString& artist, const QString& comment) {
        ByteWriter body;
        const std::vector<std::vector<std::uint8_t>> texts = {Utf16(title), Utf16(artist),
                                                              Utf16(QStringLiteral("(c)")), Utf16(comment),
                                                              Utf16(QStringLiteral("rating"))};
        for (const auto& text : texts)
            body.U16Le(static_cast<std::uint16_t>(text.size()));
        for (const auto& text : texts)
            body.Raw(text);
        return Add(Object(kContent, body));
    }

    struct Attribute {
        QString name;
        std::uint16_t type;
        std::vector<std::uint8_t> value;
    };
    static Attribute TextAttribute(const QString& name, const QString& text) {
        return {name, 0, Utf16(text)};
    }
    // A little-endian number of `size` bytes.
    static Attribute NumberAttribute(const QString& name, std::uint16_t type, std::uint64_t number,
                                     std::size_t size) {
        ByteWriter value;
        value.U64Le(number);
        return {name, type, {value.Bytes().begin(), value.Bytes().begin() + static_cast<long>(size)}};
    }

    static ByteWriter ExtendedBody(const std::vector<Attribute>& attributes) {
        ByteWriter body;
        body.U16Le(static_cast<std::uint16_t>(attributes.size()));
        for (const auto& attribute : attributes) {
            const auto name = Utf16(attribute.name);
            body.U16Le(static_cast<std::uint16_t>(name.size()));
            body.Raw(name);
            body.U16Le(attribute.type);
            body.U16Le(static_cast<std::uint16_t>(attribute.value.size()));
            body.Raw(attribute.value);
        }
        return body;
    }
    AsfBuilder& Extended(const std::vector<Attribute>& attributes) {
        return Add(Object(kExtendedContent, ExtendedBody(attributes)));
    }

    // The metadata library, wrapped in a header extension.
    AsfBuilder& Library(const std::vector<Attribute>& attributes) {
        ByteWriter library;
        library.U16Le(static_cast<std::uint16_t>(attributes.size()));
        for (const auto& attribute : attributes) {
            const auto name = Utf16(attribute.name);
            library.U32Le(0);
            library.U16Le(static_cast<std::uint16_t>(name.size()));
            library.U16Le(attribute.type);
            library.U32Le(static_cast<std::uint32_t>(attribute.value.size()));
            library.Raw(name);
            library.Raw(attribute.value);
        }
        const auto object = Object(kMetadataLibrary, library);
        ByteWriter extension;
        extension.Zeros(16);
        extension.U16Le(6);
        extension.U32Le(static_cast<std::uint32_t>(object.size()));
        extension.Raw(object);
        return Add(Object(kHeaderExtension, extension));
    }

    AsfBuilder& FileProperties(std::uint64_t creation, std::uint64_t duration, std::uint64_t preroll,
                               std::uint32_t flags = 0, std::uint32_t maxBitRate = 0) {
        ByteWriter body;
        body.Zeros(24);
        body.U64Le(creation);
        body.U64Le(1);
        body.U64Le(duration);
        body.U64Le(duration);
        body.U64Le(preroll);
        body.U32Le(flags);
        body.Zeros(8);
        body.U32Le(maxBitRate);
        return Add(Object(kFileProperties, body));
    }

    AsfBuilder& Stream(const char* media, std::uint16_t channels, std::uint32_t sampleRate,
                       std::uint32_t bytesPerSecond, std::uint16_t blockAlign, std::uint16_t flags = 1) {
        ByteWriter body;
        body.Raw(Guid(media));
        body.Zeros(24);
        body.U32Le(18);
        body.U32Le(0);
        body.U16Le(flags);
        body.U32Le(0);
        body.U16Le(0x161);
        body.U16Le(channels);
        body.U32Le(sampleRate);
        body.U32Le(bytesPerSecond);
        body.U16Le(blockAlign);
        body.U32Le(16);
        return Add(Object(kStreamProperties, body));
    }

    struct Codec {
        std::uint16_t type;
        QString name;
        QString description;
    };
    AsfBuilder& Codecs(const std::vector<Codec>& codecs) {
        ByteWriter body;
        body.Zeros(16);
        body.U32Le(static_cast<std::uint32_t>(codecs.size()));
        for (const auto& codec : codecs) {
            body.U16Le(codec.type);
            for (const auto& text : {Utf16(codec.name), Utf16(codec.description)}) {
                body.U16Le(static_cast<std::uint16_t>(text.size() / 2));
                body.Raw(text);
            }
            body.U16Le(2);
            body.U16Le(0x161);
        }
        return Add(Object(kCodecList, body));
    }

    // `declaredSize` 0: the true one.
    std::vector<std::uint8_t> Build(std::uint64_t declaredSize = 0) const {
        ByteWriter file;
        file.Raw(Guid("75B22630-668E-11CF-A6D9-00AA0062CE6C"));
        file.U64Le(declaredSize != 0 ? declaredSize : 30 + objects_.Size());
        file.U32Le(count_);
        file.U16Le(0x0201);
        file.Raw(objects_.Bytes());
        return file.Bytes();
    }

 private:
    ByteWriter objects_;
    std::uint32_t count_ = 0;
};
