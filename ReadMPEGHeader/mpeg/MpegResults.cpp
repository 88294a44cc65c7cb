#include "ReadMPEGHeader/mpeg/MpegResults.h"

namespace {

MpegResults& Stored() {
    static MpegResults results;
    return results;
}

}  // namespace

const MpegResults& LastMpegResults() {
    return Stored();
}

void StoreMpegResults(const MpegResults& results) {
    Stored() = results;
}
