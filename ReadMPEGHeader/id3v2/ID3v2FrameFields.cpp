#include "ReadMPEGHeader/id3v2/ID3v2FrameFields.h"

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
