#pragma once

// Qt's own reading of a dark desktop's colours leaves what stands in empty fields black. It is the fields'
// text colour then, but paler, wherever it would be hard to tell from their ground.
void KeepPlaceholdersLegible();
