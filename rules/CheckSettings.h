#pragma once

// Process-wide settings of a check, written once by the command line before
// any document is read and only read afterwards.

// Non-zero with "-L": only files flagged "@ZOR2Level" "L1" are checked, and
// their level and usage are compared.
extern int OnlyFlaggedFiles;
// The release the check is made for ("-level M4R20" gives 20; 99 by default).
extern int CurrentLevel;
