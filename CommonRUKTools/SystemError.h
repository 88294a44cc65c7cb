#pragma once

#include <QString>

// What the system's error number (errno) means, in words for the user: "Der Datenträger ist voll".
QString SystemErrorText(int error);
