#include "describe/interface_document.h"

#include "platform/xml/xml_characters.h"

namespace zor2::describe {

std::string DocumentText(std::string_view text) {
  // Most texts are printable ASCII, which stays as it is.
  bool plain = true;
  for (char c : text) plain = plain && c >= 0x20 && c < 0x7F;
  if (plain) return std::string(text);
  static constexpr char kHex[] = "0123456789ABCDEF";
  std::string kept;
  kept.reserve(text.size());
  while (!text.empty()) {
    char32_t code_point = 0;
    const size_t length = xml::DecodeUtf8(text, &code_point);
    if (length > 0 && xml::IsXmlCharacter(code_point)) {
      kept.append(text.substr(0, length));
      text.remove_prefix(length);
      continue;
    }
    // A byte that is no UTF-8, or a character that XML forbids, is written
    // as an escape, one byte at a time, so that nothing is lost from sight.
    const size_t bytes = length > 0 ? length : 1;
    for (size_t i = 0; i < bytes; ++i) {
      const auto byte = static_cast<unsigned char>(text[i]);
      kept += "\\x";
      kept += kHex[byte >> 4];
      kept += kHex[byte & 0xF];
    }
    text.remove_prefix(bytes);
  }
  return kept;
}

namespace {

void Set(xml::OutputElement* element, std::string_view name, std::string_view value) {
  element->SetAttribute(name, DocumentText(value));
}

void SetOptional(xml::OutputElement* element, std::string_view name,
                 const std::optional<std::string>& value) {
  if (value) Set(element, name, *value);
}

void SetLine(xml::OutputElement* element, unsigned line) {
  if (line > 0) element->SetAttribute("Line", std::to_string(line));
}

void AddMethod(xml::OutputElement* parent, const MethodDescription& method) {
  xml::OutputElement* element = parent->AddChild("Method");
  Set(element, "Name", method.name);
  Set(element, "Access", method.access);
  Set(element, "Type", method.type);
  SetOptional(element, "Property", method.property);
  SetOptional(element, "ReturnedType", method.returned_type);
  Set(element, "Signature", method.signature);
  if (method.nodoc) element->SetAttribute("@nodoc", "Y");
  SetOptional(element, "Deprecated", method.deprecated);
  SetLine(element, method.line);
  if (method.implicit) element->SetAttribute("Implicit", "Y");
  for (const ArgDescription& arg : method.args) {
    xml::OutputElement* arg_element = element->AddChild("Arg");
    Set(arg_element, "Type", arg.type);
    Set(arg_element, "Name", arg.name);
    SetOptional(arg_element, "Value", arg.value);
    if (arg.retval) arg_element->SetAttribute("Retval", "Y");
  }
}

}  // namespace

std::unique_ptr<xml::OutputElement> BuildDocument(const FrameworkDescription& framework) {
  auto root = std::make_unique<xml::OutputElement>("Workspace");
  xml::OutputElement* framework_element = root->AddChild("Framework");
  Set(framework_element, "Name", framework.name);
  for (const GroupDescription& group : framework.groups) {
    xml::OutputElement* group_element = framework_element->AddChild("Interfaces");
    group_element->SetAttribute("Name", group.name);
    for (const FileDescription& file : group.files) {
      xml::OutputElement* file_element = group_element->AddChild("File");
      Set(file_element, "Name", file.name);
      Set(file_element, "Aut", file.aut);
      SetOptional(file_element, "@ZOR2Level", file.level);
      SetOptional(file_element, "@ZOR2Usage", file.usage);
      SetLine(file_element, 1);
      for (const ClassDescription& described : file.classes) {
        xml::OutputElement* class_element = file_element->AddChild("Class");
        Set(class_element, "Name", described.name);
        Set(class_element, "Aut", described.aut);
        SetOptional(class_element, "Deprecated", described.deprecated);
        SetLine(class_element, described.line);
        for (const MethodDescription& method : described.methods) {
          AddMethod(class_element, method);
        }
      }
    }
  }
  return root;
}

}  // namespace zor2::describe
