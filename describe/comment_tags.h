#pragma once

#include <optional>
#include <string>
#include <string_view>
#include <vector>

namespace zor2::describe {

// The tags that carry what only a team knows about its interfaces. A tag is
// written in a comment as '@' and its name, as a word of its own; a tag with a
// value takes the next word on the same line.

// The file tags: taken from the first comment of the header that holds each.
struct FileTags {
  std::optional<std::string> level;  // @ZOR2Level L1
  std::optional<std::string> usage;  // @ZOR2Usage U1
  bool not_automation = false;       // @ZOR2NoAut
};

// The tags of the comment just above a class or a method.
struct DeclarationTags {
  bool automation = false;                        // @ZOR2Aut (classes)
  bool nodoc = false;                             // @nodoc (methods)
  std::optional<std::string> property;            // @ZOR2Property R (methods)
  std::vector<std::string> retval_names;          // @ZOR2Retval oName (methods), in order
  bool deprecated = false;                        // @deprecated
  std::optional<std::string> deprecated_release;  // @deprecated M4R18
};

// The comments of the C++ source `source`, in order, each with its markers
// ("// ..." up to the line end, "/* ... */"). Comment markers inside string
// and character literals are not comments.
std::vector<std::string_view> CommentsIn(std::string_view source);

// True when `comment` holds the tag `name` ("@nodoc") as a word; `value` then
// gets the next word on the same line (empty when there is none or when the
// next word is another tag).
bool FindTag(std::string_view comment, std::string_view name, std::string* value);

// The first word of `text` written like a release (letters, digits, "R",
// digits: M4R18), or nothing.
std::optional<std::string> FindRelease(std::string_view text);

// The file tags of the header whose text is `source`.
FileTags ReadFileTags(std::string_view source);

// The tags of the declaration comment `comment`.
DeclarationTags ReadDeclarationTags(std::string_view comment);

}  // namespace zor2::describe
