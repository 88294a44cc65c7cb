#include "cli/JsonOutput.h"

#include <algorithm>
#include <charconv>
#include <cmath>
#include <type_traits>

#include "MusicManagment/database/SongFields.h"

namespace {

constexpr std::size_t kLongestEscape = 6;   // bytes of one UTF-16 unit: \u001F
constexpr std::size_t kLongestNumber = 32;  // a double takes at most 24
constexpr char16_t kReplacement = 0xFFFD;

bool IsPlain(char16_t c) {
    return c >= 0x20 && c < 0x80 && c != u'"' && c != u'\\';
}

char* PutEscape(char* out, char16_t c) {
    constexpr std::string_view kDigits = "0123456789abcdef";
    *out++ = '\\';
    switch (c) {
        case u'"':
        case u'\\':
            *out++ = static_cast<char>(c);
            return out;
        case u'\n':
            *out++ = 'n';
            return out;
        case u'\r':
            *out++ = 'r';
            return out;
        case u'\t':
            *out++ = 't';
            return out;
        default:
            for (const char digit : {'u', '0', '0', kDigits[c >> 4 & 15u], kDigits[c & 15u]})
                *out++ = digit;
            return out;
    }
}

char* PutUtf8(char* out, char32_t code) {
    const auto put = [&out](char32_t byte) { *out++ = static_cast<char>(byte); };
    if (code < 0x800) {
        put(0xC0 | code >> 6);
    } else if (code < 0x10000) {
        put(0xE0 | code >> 12);
        put(0x80 | (code >> 6 & 0x3F));
    } else {
        put(0xF0 | code >> 18);
        put(0x80 | (code >> 12 & 0x3F));
        put(0x80 | (code >> 6 & 0x3F));
    }
    put(0x80 | (code & 0x3F));
    return out;
}

// The character at `i`, which moves to its last unit. Half a pair is no character: readers refuse it.
char32_t CharacterAt(QStringView text, qsizetype& i) {
    const QChar c = text[i];
    if (!c.isSurrogate()) return c.unicode();
    if (c.isLowSurrogate() || i + 1 == text.size() || !text[i + 1].isLowSurrogate()) return kReplacement;
    return QChar::surrogateToUcs4(c, text[++i]);
}

}  // namespace

void JsonLine::Begin() {
    used_ = 0;
    Put("{");
    first_ = true;
}

QByteArrayView JsonLine::End() {
    Put("}\n");
    return {line_.data(), static_cast<qsizetype>(used_)};
}

// At least `size` free bytes behind what is written.
char* JsonLine::Room(std::size_t size) {
    if (line_.size() - used_ < size) line_.resize(2 * (used_ + size));
    return line_.data() + used_;
}

void JsonLine::Put(std::string_view text) {
    std::copy(text.begin(), text.end(), Room(text.size()));
    used_ += text.size();
}

void JsonLine::Separate() {
    if (!first_) Put(",");
    first_ = false;
}

void JsonLine::PutKey(std::string_view key) {
    Separate();
    char* out = Room(key.size() + 3);
    *out++ = '"';
    out = std::copy(key.begin(), key.end(), out);
    *out++ = '"';
    *out = ':';
    used_ += key.size() + 3;
}

void JsonLine::PutQuoted(QStringView text) {
    char* const begin = Room(2 + static_cast<std::size_t>(text.size()) * kLongestEscape);
    char* out = begin;
    *out++ = '"';
    for (qsizetype i = 0; i < text.size(); ++i) {
        const char16_t c = text[i].unicode();
        if (IsPlain(c))
            *out++ = static_cast<char>(c);
        else
            out = c < 0x80 ? PutEscape(out, c) : PutUtf8(out, CharacterAt(text, i));
    }
    *out++ = '"';
    used_ += static_cast<std::size_t>(out - begin);
}

template <typename T>
void JsonLine::PutNumber(T value) {
    char* const begin = Room(kLongestNumber);
    used_ += static_cast<std::size_t>(std::to_chars(begin, begin + kLongestNumber, value).ptr - begin);
}

void JsonLine::Text(std::string_view key, QStringView value) {
    PutKey(key);
    PutQuoted(value);
}

void JsonLine::Texts(std::string_view key, const QStringList& values) {
    BeginArray(key);
    for (const QString& value : values) {
        Separate();
        PutQuoted(value);
    }
    EndArray();
}

void JsonLine::Number(std::string_view key, qint64 value) {
    PutKey(key);
    PutNumber(value);
}

void JsonLine::Real(std::string_view key, double value) {
    if (!std::isfinite(value)) return Null(key);
    PutKey(key);
    PutNumber(value);
}

void JsonLine::Flag(std::string_view key, bool value) {
    PutKey(key);
    Put(value ? "true" : "false");
}

void JsonLine::Null(std::string_view key) {
    PutKey(key);
    Put("null");
}

void JsonLine::BeginArray(std::string_view key) {
    PutKey(key);
    Put("[");
    first_ = true;
}

void JsonLine::EndArray() {
    Close(']');
}

void JsonLine::BeginItem() {
    Separate();
    Put("{");
    first_ = true;
}

void JsonLine::EndItem() {
    Close('}');
}

void JsonLine::Close(char bracket) {
    Put({&bracket, 1});
    first_ = false;
}

void WriteSongFields(JsonLine& line, const TID3Tag& song) {
    for (const RecordMember& row : RecordMembers()) {
        const auto write = [&](auto member) {
            using Value = std::remove_cvref_t<decltype(song.*member)>;
            if constexpr (std::is_same_v<Value, QString>)
                line.Text(row.Name, song.*member);
            else if constexpr (std::is_same_v<Value, bool>)
                line.Flag(row.Name, song.*member);
            else if constexpr (std::is_same_v<Value, double>)
                line.Real(row.Name, song.*member);
            else
                line.Number(row.Name, song.*member);
        };
        std::visit(write, row.Member);
    }
}
