#include "CommonRUKTools/WriteGate.h"

namespace {

class OpenGate : public WriteGate {
 public:
    int Before(DiskStep, const QString&) override { return 0; }
};

WriteGate*& Installed() {
    static WriteGate* gate = nullptr;
    return gate;
}

}  // namespace

WriteGate& CurrentWriteGate() {
    static OpenGate open;
    return Installed() != nullptr ? *Installed() : open;
}

void SetWriteGate(WriteGate* gate) {
    Installed() = gate;
}
