#pragma once

#include <optional>
#include <string>
#include <vector>

namespace zor2::describe {

// What zor2describe learns about a framework from its headers, before it is
// written as an interface description document. Optional values are
// attributes that are left out when absent.

struct ArgDescription {
  std::string type;                  // the type's identity (see type_spelling.h)
  std::string name;                  // empty for an unnamed parameter
  std::optional<std::string> value;  // the default argument's source text
  bool retval = false;               // named by the method's @ZOR2Retval tag
};

struct MethodDescription {
  std::string name;
  std::string access;  // "Public", "Protected" or "Private"
  std::string type;    // "PureVirtual", "Virtual", "NonVirtual" or "Static"
  std::optional<std::string> property;
  std::optional<std::string> returned_type;  // absent for constructors and destructors
  std::string signature;
  bool nodoc = false;
  std::optional<std::string> deprecated;
  std::vector<ArgDescription> args;
  unsigned line = 0;      // of the declaration; 0 for a member the compiler declares
  bool implicit = false;  // declared by the compiler, not written in the header
};

struct ClassDescription {
  std::string name;  // qualified, without a leading "::"
  std::string aut;   // "Y" for an automation class, else "N"
  std::optional<std::string> deprecated;
  std::vector<MethodDescription> methods;
  unsigned line = 0;  // of the definition
};

struct FileDescription {
  std::string name;  // the path relative to its group's directory, with '/'
  std::string aut;   // "Y" unless the header says otherwise
  std::optional<std::string> level;
  std::optional<std::string> usage;
  std::vector<ClassDescription> classes;
};

struct GroupDescription {
  std::string name;  // "Public" or "Protected"
  std::vector<FileDescription> files;
};

struct FrameworkDescription {
  std::string name;
  std::vector<GroupDescription> groups;
};

// The class that holds the free functions of the global namespace; those of a
// named namespace are held by a class named after the namespace. No C++ class
// can be named so.
inline constexpr char kGlobalNamespaceClass[] = "::";

}  // namespace zor2::describe
