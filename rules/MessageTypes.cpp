#include "rules/MessageTypes.h"

#include <cstdlib>

#include "platform/tools/TAIndex.h"

namespace {

// The thirteen message types, in the order in which they are registered and
// listed on the help page.
constexpr ZOR2ErrorType kMessageTypes[] = {
    {"FHBD", "File Has Been Deleted",
     "Deleting a ZOR2 File (L1 or L2) is not allowed.<BR>Current file is L1 or L2, was present in "
     "Reference WS and has disappeared in checked WS."},
    {"LHC", "@ZOR2Level Has Changed",
     "Changing a ZOR2Level tag is not allowed (this tag has changed or disappeared).@ZOR2Level has "
     "either changed or been deleted."},
    {"UHC", "@ZOR2Usage Has Changed",
     "@ZOR2Usage has either disappeared or changed in a wrong way.<BR>The following changes are "
     "only allowed :<BR><PRE>     U1 -> U2 <BR>     U3 -> U4 <BR>     U3 -> U5 <BR></PRE>"},
    {"CHBD", "Class Has Been Deleted",
     "Deleting a Class is not allowed in a L1 or L2 interface.<BR>Current class was declared in "
     "current file in Reference WS and is no more declared in this file"},
    {"MHBDM", "Method Has Been Deleted or Modified",
     "Deleting or a modifying a Public or Protected Method is not allowed in a ZOR2 "
     "interface.<BR>Current method was declared for current class in Reference WS and is no more "
     "declared in Checked WS.<BR>A method is seen as identical if : <BR><PRE>\t\t- the name is the "
     "same <BR>\t\t- the access (Public, Protected, Private) is the same <BR>\t\t- for each "
     "argument the type is the same</PRE>"},
    {"NPVM", "New Pure Virtual Method",
     "Declaring a new Pure Virtual Method for a U2 or U5 class is not allowed (even if this method "
     "is nodoc).<BR>Current method is pure virtual, was not declared in Reference WS and is "
     "declared in Checked WS."},
    {"ADVHC", "Argument Default Value Has Changed",
     "Default value of current Method argument has appeared, disappeared or changed"},
    {"MRTHC", "Method Returned Type Has Changed",
     "Returned Type of current method is different between reference WS and checked WS"},
    {"INDM", "Illegal nodoc Method",
     "Method is @nodoc in checked level and was not in reference level"},
    {"CINMA", "Class Is No More Automation",
     "Class that was declared for automation is not an automation class anymore"},
    {"PMHC", "Property Modifier Has Changed", "The Property modifier of a Method has changed"},
    {"MOHBC", "Method Order Has Been Changed",
     "The orders of the methods has changed for an automation class"},
    {"ARVHC", "Automation Return Value Has Changed",
     "IDLRETVAL modifier has been changed for parameters of the method"},
};

// A broken table is a programming error that no run can work around.
void Register(TAIndex& index, const ZOR2ErrorType& type) {
  if (type.code == nullptr || type.code[0] == '\0') std::abort();
  if (index.IsIn(type.code) >= 0) std::abort();
  // The index holds untyped pointers; they are only ever read back as const.
  index.Append(type.code, const_cast<ZOR2ErrorType*>(&type));
}

// Built from the table on first use, so that its order never depends on the
// order in which the program's files are initialised.
const TAIndex& Index() {
  static const TAIndex index = [] {
    TAIndex built;
    for (const ZOR2ErrorType& type : kMessageTypes) Register(built, type);
    return built;
  }();
  return index;
}

// Registers the types before main runs, so that a broken table stops the
// program before it reads anything.
[[maybe_unused]] const bool registeredAtStart = (Index(), true);

}  // namespace

const MessageTypeRegistry& MessageTypeRegistry::Get() {
  static const MessageTypeRegistry registry;
  Index();
  return registry;
}

const ZOR2ErrorType* MessageTypeRegistry::Find(const char* code) const {
  if (code == nullptr) return nullptr;
  int position = Index().IsIn(code);
  return position < 0 ? nullptr : At(position);
}

int MessageTypeRegistry::Count() const {
  return Index().Count();
}

const ZOR2ErrorType* MessageTypeRegistry::At(int position) const {
  if (position < 0 || position >= Count()) return nullptr;
  return static_cast<const ZOR2ErrorType*>(Index().ValueAt(position));
}
