#pragma once

// Reports a broken internal invariant on standard error, with `text` and the
// source position, and aborts the process.
[[noreturn]] void QEXFatalError(const char* text, const char* file, int line);
