#pragma once

#include <clang-c/Index.h>

#include <map>
#include <string>
#include <vector>

#include "describe/interface_model.h"
#include "describe/type_spelling.h"

namespace zor2::describe {

// What C++ says about a class beyond the members written in it: the special
// members the compiler declares for it, and whether clients can derive from it.

// The special members that a class declares itself.
struct DeclaredMembers {
  bool any_constructor = false;
  bool default_constructor = false;  // usable or not
  bool copy_constructor = false;
  bool move_constructor = false;
  bool copy_assignment = false;
  bool move_assignment = false;
  bool destructor = false;
  bool usable_default_constructor = false;
  bool usable_copy_constructor = false;
  bool usable_copy_assignment = false;
  bool public_or_protected_constructor = false;
  bool virtual_function = false;
  bool virtual_destructor = false;
};

// What C++ says about the classes of one unit, beyond the members written in
// them. What each class declares is read once and kept, so that a class used
// as a member or a base of many others is read once.
//
// Thread safety: one object serves one unit walk, on one thread.
class ClassFacts {
 public:
  // Adds to `described` the default constructor, copy constructor, copy
  // assignment and destructor that the compiler declares for the class
  // `definition` and that are usable: those the class does not declare
  // itself, unless a declaration of its own, a member or a base suppresses or
  // deletes them. Members and bases are looked at, and their own members and
  // bases, a few levels deep; what libclang cannot tell (a member whose type
  // depends on a template parameter) counts as usable.
  void AddImplicitMembers(CXCursor definition, const TemplateParameters& parameters,
                          ClassDescription* described);

  // Whether clients can derive from the class `definition` and override its
  // virtual functions: it is polymorphic (declares or inherits a virtual
  // function), is not final, and has a public or protected constructor (one
  // it declares, or the one the compiler declares when it declares none).
  bool IsDerivablePolymorphic(CXCursor definition);

 private:
  // What the members and bases of a class keep the compiler from providing.
  struct Obstacles {
    bool default_constructor = false;
    bool copy_constructor = false;
    bool copy_assignment = false;
  };

  const DeclaredMembers& Declared(CXCursor definition);
  // Whether `definition` or a class it derives from, at any depth, declares a
  // virtual function (`destructor_only`: a virtual destructor).
  bool InheritsVirtual(CXCursor definition, bool destructor_only);
  // A member or base of class type: what it denies, by its own declarations
  // or, for what it leaves to the compiler, by its members and bases in turn
  // (`depth` levels down so far).
  void AddClassObstacles(CXCursor definition, int depth, Obstacles* obstacles);
  // What the members and bases of the class `definition` deny, kept.
  const Obstacles& ObstaclesOf(CXCursor definition, int depth);
  Obstacles FindObstacles(CXCursor definition, int depth);

  std::map<std::string, DeclaredMembers> declared_;  // by USR
  std::map<std::string, Obstacles> obstacles_;       // by USR
};

}  // namespace zor2::describe
