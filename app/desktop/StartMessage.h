#pragma once

#include <QByteArray>
#include <optional>

#include "app/desktop/SingleInstance.h"

// How one start of the program speaks to another: a magic word of 4 bytes, the length of the rest (32 bits,
// little-endian), and UTF-8 texts that end with a zero byte each: the activation token, then the arguments.
namespace StartMessage {

inline constexpr qsizetype kHeadSize = 8;
// More than a system lets a command line be.
inline constexpr quint32 kLargestBody = 8U << 20;

QByteArray Encode(const StartRequest& request);
// Length of the body that is announced; nothing when the head is not one of ours or announces too much.
std::optional<quint32> BodySize(const QByteArray& head);
std::optional<StartRequest> DecodeBody(const QByteArray& body);

}  // namespace StartMessage
