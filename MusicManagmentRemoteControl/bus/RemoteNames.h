#pragma once

#include <QString>

// Where the remote control stands on the bus.
inline const QString kRemoteService = QStringLiteral("de.tunestead.RemoteControl");
inline const QString kRemotePath = QStringLiteral("/TRemoteControlWnd");
inline const QString kRemoteInterface = QStringLiteral("de.tunestead.RemoteControl");
