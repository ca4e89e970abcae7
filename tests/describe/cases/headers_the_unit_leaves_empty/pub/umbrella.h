// Includes only: declares nothing of its own.
#pragma once
#include "first.h"
