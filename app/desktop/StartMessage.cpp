#include "app/desktop/StartMessage.h"

#include <string_view>

#include "CommonRUKTools/ByteReader.h"
#include "CommonRUKTools/ByteWriter.h"

namespace {

constexpr std::string_view kMagic = "TSI1";

}  // namespace

QByteArray StartMessage::Encode(const StartRequest& request) {
    QByteArray body = request.ActivationToken.toUtf8() + '\0';
    for (const QString& argument : request.Arguments)
        body += argument.toUtf8() + '\0';
    ByteWriter head;
    head.Raw(kMagic);
    head.U32Le(static_cast<std::uint32_t>(body.size()));
    return QByteArray(reinterpret_cast<const char*>(head.Bytes().data()), kHeadSize) + body;
}

std::optional<quint32> StartMessage::BodySize(const QByteArray& head) {
    if (head.size() < kHeadSize || !head.startsWith(QByteArrayView(kMagic.data(), kMagic.size()))) return {};
    ByteReader reader(AsBytes(std::string_view(head.constData(), static_cast<std::size_t>(kHeadSize))));
    reader.Skip(kMagic.size());
    const quint32 size = reader.U32Le();
    return size <= kLargestBody ? std::optional(size) : std::nullopt;
}

std::optional<StartRequest> StartMessage::DecodeBody(const QByteArray& body) {
    if (!body.endsWith('\0')) return {};
    const QByteArrayList texts = body.chopped(1).split('\0');
    StartRequest request;
    request.ActivationToken = QString::fromUtf8(texts.first());
    for (qsizetype i = 1; i < texts.size(); ++i)
        request.Arguments << QString::fromUtf8(texts[i]);
    return request;
}
