#pragma once

#include "CommonRUKTools/Dialogs.h"
#include "MusicManagment/database/batches/GenreAdaption.h"
#include "MusicManagment/database/batches/LengthBatch.h"

// Tells the user what came of a batch: a sentence, and the songs that did not go as wished.

void ReportBatch(const BatchResult& result, std::vector<ReportSection> sections = {});
void ReportAdaption(const GenreAdaption& result);
void ReportLengths(const LengthBatchResult& result);
// Marks beyond the limit are not passed over without a word.
void TellOfPassedMarks(const BatchSongs& songs);
