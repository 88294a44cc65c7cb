#pragma once

class TRWReg;

// Gives a store that holds nothing yet what a new installation has otherwise than a component that nobody has
// set: the `New` of the settings. What an existing installation has stays.
void BeginInstallation(TRWReg& settings);
