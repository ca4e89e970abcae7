#include "documents/json_writer.h"

#include "documents/export_text.h"

namespace zor2 {

void JsonWriter::BeforeValue() {
  if (after_key_) {
    after_key_ = false;
    return;
  }
  if (empty_.empty()) return;
  if (!empty_.back()) out_->push_back(',');
  empty_.back() = false;
  if (!indented_) return;
  out_->push_back('\n');
  out_->append(2 * empty_.size(), ' ');
}

void JsonWriter::Close(char bracket) {
  const bool was_empty = empty_.back();
  empty_.pop_back();
  if (!was_empty && indented_) {
    out_->push_back('\n');
    out_->append(2 * empty_.size(), ' ');
  }
  out_->push_back(bracket);
}

void JsonWriter::BeginObject() {
  BeforeValue();
  out_->push_back('{');
  empty_.push_back(true);
}

void JsonWriter::EndObject() {
  Close('}');
}

void JsonWriter::BeginArray() {
  BeforeValue();
  out_->push_back('[');
  empty_.push_back(true);
}

void JsonWriter::EndArray() {
  Close(']');
}

void JsonWriter::Key(std::string_view key) {
  BeforeValue();
  AppendJsonString(key, out_);
  out_->append(indented_ ? ": " : ":");
  after_key_ = true;
}

void JsonWriter::String(std::string_view value) {
  BeforeValue();
  AppendJsonString(value, out_);
}

void JsonWriter::Number(long long value) {
  BeforeValue();
  out_->append(std::to_string(value));
}

void JsonWriter::Bool(bool value) {
  BeforeValue();
  out_->append(value ? "true" : "false");
}

void JsonWriter::Member(std::string_view key, const std::vector<std::string>& values) {
  Key(key);
  BeginArray();
  for (const std::string& value : values) String(value);
  EndArray();
}

}  // namespace zor2
