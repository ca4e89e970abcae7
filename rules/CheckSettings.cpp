#include "rules/CheckSettings.h"

int OnlyFlaggedFiles = 0;
int CurrentLevel = 99;
