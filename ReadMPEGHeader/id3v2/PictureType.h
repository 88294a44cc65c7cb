#pragma once

#include <QString>

// German text of the picture type in an "APIC" frame.
QString PictureTypeText(int type);
