#include "documents/TypeNameNormalization.h"

#include "platform/tools/WordReplace.h"

namespace {

struct Rewrite {
  const char* first;
  const char* second;
  const char* third;
  const char* replacement;
};

// Longer sequences come before their shorter tails. "long double" is parked as
// "QEXDOUBLE128" so that the lone "long" row leaves it alone, then restored.
constexpr Rewrite kRewrites[] = {
    {"unsigned", "long", "long", "QEXULONG64"},
    {"signed", "long", "long", "QEXLONG64"},
    {"long", "long", nullptr, "QEXLONG64"},
    {"unsigned", "long", "int", "QEXULONG32"},
    {"signed", "long", "int", "QEXLONG32"},
    {"long", "int", nullptr, "QEXLONG32"},
    {"unsigned", "long", nullptr, "QEXULONG32"},
    {"signed", "long", nullptr, "QEXLONG32"},
    {"long", "double", nullptr, "QEXDOUBLE128"},
    {"long", nullptr, nullptr, "QEXLONG32"},
    {"QEXDOUBLE128", nullptr, nullptr, "long double"},
};

// Every row needs "long" in the text, except the last, which needs
// "QEXDOUBLE128"; nearly every attribute value has neither.
bool MayNeedRewriting(std::string_view value) {
  return value.find("long") != std::string_view::npos ||
         value.find("QEXDOUBLE128") != std::string_view::npos;
}

}  // namespace

int NormalizeTypeNames(std::string_view value, std::string& rewritten) {
  if (!MayNeedRewriting(value)) return 0;
  std::string text(value);
  int changed = 0;
  for (const Rewrite& r : kRewrites) {
    changed |= replace(text, r.first, r.second, r.third, r.replacement);
  }
  if (changed == 0) return 0;
  rewritten = std::move(text);
  return 1;
}
