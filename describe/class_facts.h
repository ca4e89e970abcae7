#pragma once

#include <clang-c/Index.h>

#include <vector>

#include "describe/interface_model.h"
#include "describe/type_spelling.h"

namespace zor2::describe {

// What C++ says about a class beyond the members written in it: the special
// members the compiler declares for it, and whether clients can derive from it.

// Adds to `described` the default constructor, copy constructor, copy
// assignment and destructor that the compiler declares for the class
// `definition` and that are usable: those the class does not declare itself,
// unless a declaration of its own, a member or a base suppresses or deletes
// them. Members and bases are looked at one level deep; what libclang cannot
// tell (a dependent member's type) counts as usable.
void AddImplicitMembers(CXCursor definition, const TemplateParameters& parameters,
                        ClassDescription* described);

// Whether clients can derive from the class `definition` and override its
// virtual functions: it is polymorphic (declares or inherits a virtual
// function), is not final, and has a public or protected constructor (one it
// declares, or the one the compiler declares when it declares none).
bool IsDerivablePolymorphic(CXCursor definition);

}  // namespace zor2::describe
