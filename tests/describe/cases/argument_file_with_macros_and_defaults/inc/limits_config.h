#pragma once
#define LIB_EXPORT
