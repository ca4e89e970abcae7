#pragma once

#include <string>
#include <string_view>
#include <vector>

namespace zor2 {

// Writes JSON to a string, indented (each member and element on its own line,
// two spaces per level) or, for large files that only tools read, compact.
// The caller keeps the calls balanced and calls Key before each member's
// value.
class JsonWriter {
 public:
  enum class Layout { kIndented, kCompact };
  explicit JsonWriter(std::string* out, Layout layout = Layout::kIndented)
      : out_(out), indented_(layout == Layout::kIndented) {}

  void BeginObject();
  void EndObject();
  void BeginArray();
  void EndArray();
  void Key(std::string_view key);
  void String(std::string_view value);
  void Number(long long value);
  void Bool(bool value);

  // A member with a simple value.
  void Member(std::string_view key, std::string_view value) {
    Key(key);
    String(value);
  }
  void Member(std::string_view key, const char* value) { Member(key, std::string_view(value)); }
  void Member(std::string_view key, int value) {
    Key(key);
    Number(value);
  }
  void Member(std::string_view key, bool value) {
    Key(key);
    Bool(value);
  }
  void Member(std::string_view key, const std::vector<std::string>& values);

 private:
  void BeforeValue();
  void Close(char bracket);

  std::string* out_;
  bool indented_;
  std::vector<bool> empty_;  // per open object or array: nothing in it yet
  bool after_key_ = false;
};

}  // namespace zor2
