#pragma once

#include <string>

// Replaces in `text` every occurrence of the word sequence `first` [`second`
// [`third`]] by `replacement`. A word of the sequence matches only a whole
// word of the text (a maximal run of letters, digits and "_"); consecutive
// words of the sequence match words separated by white space; the span from
// the first matched word to the last is replaced and the rest of the text is
// kept. `second` and `third` may be null for shorter sequences (`third` must be
// null when `second` is). Returns 1 when at least one replacement was made.
int replace(std::string& text, const char* first, const char* second, const char* third,
            const char* replacement);
