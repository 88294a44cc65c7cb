#pragma once

#include <QStringList>
#include <functional>

#include "MusicManagment/conversion/EncoderSettings.h"

// Windows Media files are made by a program of the user's, which gets the name of a WAV file and that of the
// file to make. It is started with its arguments as they are, never through a shell.

// What stands for the file that is read, the one that is made, and the bit rate in kbit/s, in the arguments.
inline const QString kUsualScriptArguments = QStringLiteral("%SOURCE% %TARGET% %RATE%");

// The script that comes with Tunestead, beside the program or in ../lib/tunestead; empty when it is not
// there.
QString StandardEncoderScript();

struct ScriptCall {
    QString Program;
    QStringList Arguments;
    std::chrono::milliseconds TimeLimit;
};
// The arguments are split at blanks, with quotation marks around those that have some; the names that take
// the place of the place-holders are not split. Throws ERukException where there is no script.
ScriptCall ScriptCallFor(const EncoderSettings& settings, const QString& source, const QString& target);

// Runs it to its end, and ends it with everything that it has started when the time is over or `goOn`, which
// is asked many times a second, returns false. Throws ERukException with the reason and the last words of the
// script; EAbort when it was not to go on.
void RunScript(const ScriptCall& call, const std::function<bool()>& goOn);
