#pragma once

#include <QByteArray>
#include <functional>
#include <optional>

#include "MusicManagmentRemoteControl/RemoteMessages.h"

class TMusicDatabase;
class TPlayList;
class TPlaySound;

// What messages act on; what is not there is nullptr.
struct RemoteParts {
    TMusicDatabase* Database = nullptr;
    TPlayList* PlayList = nullptr;
    TPlaySound* PlaySound = nullptr;
    // False when there is no such window.
    std::function<bool(quint32 window, quint32 code, const QByteArray& bytes)> SendCopyData{};
};

// Does what the table says and returns the answer; nothing for a message that is not in it. Throws what the
// components throw.
std::optional<qint32> HandleRemoteMessage(const RemoteParts& parts, quint32 message, quint32 p, quint32 l);
