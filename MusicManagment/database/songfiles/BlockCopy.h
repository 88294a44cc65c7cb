#pragma once

#include <functional>

#include "CommonRUKTools/FileSource.h"
#include "CommonRUKTools/SafeFile.h"

// Copies all bytes, block by block; `stop` hears after how many bytes. False when it stopped: the target is
// then not to be committed. Throws EStreamError.
bool CopyBlocks(ByteSource& source, SafeFile& target, const std::function<bool(std::int64_t done)>& stop);
