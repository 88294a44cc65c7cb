#pragma once

#include <QString>

#include "ReadMPEGHeader/id3v2/CommentFields.h"
#include "ReadMPEGHeader/id3v2/ID3v2FrameBody.h"

// The fields of "COMM", and of "USLT", which has the same.
struct CommentFrame {
    QString Language;
    QString Description;
    QString Text;
};
CommentFrame ReadCommentFrame(FrameBody& body);

// The fields of "WXXX".
CommentFields::Address ReadAddressFrame(FrameBody& body);
