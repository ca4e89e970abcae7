#pragma once

#include <array>
#include <cstddef>
#include <string_view>

namespace zor2 {

// The thirteen kinds of finding, in the order in which the help page, the
// exports and every count list them.
enum class MessageCode {
  kFHBD,
  kLHC,
  kUHC,
  kCHBD,
  kMHBDM,
  kNPVM,
  kADVHC,
  kMRTHC,
  kINDM,
  kCINMA,
  kPMHC,
  kMOHBC,
  kARVHC,
};

// What the outputs say of a kind of finding: its short code (the report's
// "ID"), its full name and its help text, which is HTML.
struct MessageType {
  MessageCode code;
  std::string_view id;
  std::string_view full_name;
  std::string_view help;
};

inline constexpr std::array<MessageType, 13> kMessageTypes = {{
    {MessageCode::kFHBD, "FHBD", "File Has Been Deleted",
     "Deleting a ZOR2 File (L1 or L2) is not allowed.<BR>Current file is L1 or L2, was present in "
     "Reference WS and has disappeared in checked WS."},
    {MessageCode::kLHC, "LHC", "@ZOR2Level Has Changed",
     "Changing a ZOR2Level tag is not allowed (this tag has changed or disappeared).@ZOR2Level has "
     "either changed or been deleted."},
    {MessageCode::kUHC, "UHC", "@ZOR2Usage Has Changed",
     "@ZOR2Usage has either disappeared or changed in a wrong way.<BR>The following changes are "
     "only allowed :<BR><PRE>     U1 -> U2 <BR>     U3 -> U4 <BR>     U3 -> U5 <BR></PRE>"},
    {MessageCode::kCHBD, "CHBD", "Class Has Been Deleted",
     "Deleting a Class is not allowed in a L1 or L2 interface.<BR>Current class was declared in "
     "current file in Reference WS and is no more declared in this file"},
    {MessageCode::kMHBDM, "MHBDM", "Method Has Been Deleted or Modified",
     "Deleting or a modifying a Public or Protected Method is not allowed in a ZOR2 "
     "interface.<BR>Current method was declared for current class in Reference WS and is no more "
     "declared in Checked WS.<BR>A method is seen as identical if : <BR><PRE>\t\t- the name is the "
     "same <BR>\t\t- the access (Public, Protected, Private) is the same <BR>\t\t- for each "
     "argument the type is the same</PRE>"},
    {MessageCode::kNPVM, "NPVM", "New Pure Virtual Method",
     "Declaring a new Pure Virtual Method for a U2 or U5 class is not allowed (even if this method "
     "is nodoc).<BR>Current method is pure virtual, was not declared in Reference WS and is "
     "declared in Checked WS."},
    {MessageCode::kADVHC, "ADVHC", "Argument Default Value Has Changed",
     "Default value of current Method argument has appeared, disappeared or changed"},
    {MessageCode::kMRTHC, "MRTHC", "Method Returned Type Has Changed",
     "Returned Type of current method is different between reference WS and checked WS"},
    {MessageCode::kINDM, "INDM", "Illegal nodoc Method",
     "Method is @nodoc in checked level and was not in reference level"},
    {MessageCode::kCINMA, "CINMA", "Class Is No More Automation",
     "Class that was declared for automation is not an automation class anymore"},
    {MessageCode::kPMHC, "PMHC", "Property Modifier Has Changed",
     "The Property modifier of a Method has changed"},
    {MessageCode::kMOHBC, "MOHBC", "Method Order Has Been Changed",
     "The orders of the methods has changed for an automation class"},
    {MessageCode::kARVHC, "ARVHC", "Automation Return Value Has Changed",
     "IDLRETVAL modifier has been changed for parameters of the method"},
}};

// The table is indexed by the code: each entry must sit at its own code's place.
constexpr bool TableFollowsCodes() {
  for (size_t i = 0; i < kMessageTypes.size(); ++i) {
    if (static_cast<size_t>(kMessageTypes[i].code) != i) return false;
  }
  return true;
}
static_assert(TableFollowsCodes());

inline const MessageType& MessageTypeOf(MessageCode code) {
  return kMessageTypes[static_cast<size_t>(code)];
}

}  // namespace zor2
