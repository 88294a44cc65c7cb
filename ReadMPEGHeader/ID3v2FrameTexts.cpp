#include "ReadMPEGHeader/ID3v2FrameTexts.h"

using namespace Qt::StringLiterals;

CommentFrame ReadCommentFrame(FrameBody& body) {
    CommentFrame frame;
    body.ReadEncoding();
    frame.Language = body.Language();
    // Without an end of the description there is none, and all is the text.
    if (body.TextHasEnd()) frame.Description = body.Text();
    frame.Text = body.Text();
    return frame;
}

CommentFields::Address ReadAddressFrame(FrameBody& body) {
    CommentFields::Address address;
    body.ReadEncoding();
    if (body.TextHasEnd()) address.Description = body.Text();
    address.Url = body.Latin();
    return address;
}

FrameReport DescribeFrame(std::string_view id, const QString& shownId, FrameBody body) {
    const auto size = static_cast<qint64>(body.Size());
    if (id.front() != 'T') return {shownId, u"%1 Byte"_s.arg(size), size};
    body.ReadEncoding();
    return {shownId, body.Values().join(u", "), size};
}
