#pragma once

class TMusicDatabase;

// Where a rule of the first versions hurts a user of today, a modern one stands beside it. A component is
// made with the classic rules; the programs switch the modern ones on. Each pair is a setting of its own, a
// row in the `kRules` of its component's settings, so that the user can also choose one by one.
enum class Rules { Classic, Modern };

// Sets every pair of the database and of the components that have joined it (SettingsClient).
void UseRules(TMusicDatabase& database, Rules rules);
