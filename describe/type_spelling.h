#pragma once

#include <clang-c/Index.h>

#include <functional>
#include <map>
#include <string>
#include <string_view>
#include <vector>

namespace zor2::describe {

// How the describer spells a type in the attributes that zor2check compares
// ("Type", "ReturnedType"): the type the compiler sees, so that two spellings of
// one type give one text and two types give two texts. Typedefs and aliases are
// resolved (size_t and std::size_t are both "unsigned long" here), default
// template arguments and inline namespaces are left out, well-known standard
// library types keep their usual names (std::string), and template parameters
// are named by their position (T1, T2 for the outermost template's, U1 for the
// next one's), so that renaming one is not a change.

// Whether the template parameter `parameter` is a pack: a "..." before its
// name (or its default) among its own tokens, read only when the parameter is
// written out in its file.
bool IsTemplateParameterPack(CXCursor parameter);

// The template parameters that a declaration sees, with their positional names.
class TemplateParameters {
 public:
  struct Parameter {
    std::string declared;    // as the template head names it; empty when unnamed
    std::string positional;  // T1, U2 ...
    bool pack = false;
  };

  TemplateParameters() = default;
  // `levels` from the outermost template in.
  explicit TemplateParameters(std::vector<std::vector<Parameter>> levels);

  // The parameters of `declaration`, when it is a template, and of the
  // templates that enclose it.
  static TemplateParameters Around(CXCursor declaration);

  // These parameters and, one level in, those of `function` when it is a
  // function template: what a member function of the class that these
  // parameters surround sees.
  TemplateParameters With(CXCursor function) const;

  // The positional name of the parameter `index` (from 0) of the template at
  // `depth` (0 for the outermost).
  static std::string PositionalName(unsigned depth, unsigned index);

  // `text`, a type or expression as clang prints it, with every template
  // parameter named by its position: clang's "type-parameter-D-I" and each
  // identifier that names a parameter (not a member: "S::value_type" keeps
  // "value_type").
  std::string Rename(std::string_view text) const;

  // `text` with clang's "type-parameter-D-I" written as the parameter's
  // declared name, for the texts a person reads.
  std::string Written(std::string_view text) const;

  // The parameters of the innermost template (empty when there is none).
  const std::vector<Parameter>& Innermost() const;

 private:
  // The parameter at `depth` and `index`, or null.
  const Parameter* At(unsigned depth, unsigned index) const;

  std::vector<std::vector<Parameter>> levels_;
  std::map<std::string, std::string, std::less<>> positional_of_declared_;
};

// `text` with the standard library's class template specializations that have a
// usual name written so ("std::basic_string<char>" is "std::string") and the
// library's internal inline namespaces left out.
std::string WithStandardNames(std::string text);

// `text`, a type as clang prints it, less its top-level const, volatile and
// restrict: printed at its start ("const int") or, for a pointer (`pointer`),
// at its end ("int *const").
std::string WithoutTopLevelQualifiers(std::string text, bool pointer);

// The identity of `type`, as described above.
std::string TypeIdentity(CXType type, const TemplateParameters& parameters);

// The identity of a parameter declared with `type`, as it is part of its
// function's type: top-level const and volatile dropped, arrays and functions
// turned into pointers.
std::string ParameterTypeIdentity(CXType type, const TemplateParameters& parameters);

}  // namespace zor2::describe
