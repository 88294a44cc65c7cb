#include "CommonRUKTools/TextPool.h"

#include "CommonRUKTools/CodePage.h"

namespace {

constexpr std::size_t kLimit = std::size_t{32} * 1024 * 1024;
constexpr std::size_t kPerText = 100;  // headers and table places of the two texts

}  // namespace

QString TextPool::Get(ByteSpan bytes) {
    if (bytes.empty()) return {};
    const auto* data = reinterpret_cast<const char*>(bytes.data());
    const auto size = static_cast<qsizetype>(bytes.size());
    const auto known = texts_.constFind(QByteArray::fromRawData(data, size));
    if (known != texts_.cend()) return *known;

    held_ += kPerText + bytes.size();
    if (held_ > kLimit) {
        texts_.clear();
        held_ = 0;
    }
    QString text = CodePage::FromSystem(bytes);
    texts_.insert(QByteArray(data, size), text);
    return text;
}
