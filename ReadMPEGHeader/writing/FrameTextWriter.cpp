#include "ReadMPEGHeader/writing/FrameTextWriter.h"

#include <QStringList>
#include <algorithm>

#include "CommonRUKTools/CodePage.h"

namespace {

QString UpToZero(const QString& text) {
    return text.left(text.indexOf(QChar(u'\0')));
}

ByteSpan BytesOf(const QByteArray& text) {
    return AsBytes({text.constData(), static_cast<std::size_t>(text.size())});
}

}  // namespace

FrameTextWriter::FrameTextWriter(const WritingRules& rules, const QStringList& texts)
    : wide_(std::ranges::any_of(
          texts, [&rules](const QString& text) { return !rules.IsSingleByte(UpToZero(text)); })) {}

void FrameTextWriter::Text(ByteWriter& body, const QString& text) const {
    const QString written = UpToZero(text);
    if (!wide_) return body.Raw(BytesOf(CodePage::ToLegacy(written)));
    body.U16Le(0xFEFF);
    for (const QChar unit : written)
        body.U16Le(unit.unicode());
}

std::vector<std::uint8_t> PlainTextBytes(const WritingRules& rules, const QString& text) {
    const QString written = UpToZero(text);
    const QByteArray bytes = rules.IsSingleByte(written) ? CodePage::ToLegacy(written) : written.toUtf8();
    return {BytesOf(bytes).begin(), BytesOf(bytes).end()};
}
