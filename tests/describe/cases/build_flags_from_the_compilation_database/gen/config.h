#pragma once
typedef unsigned long lib_size_t;
