#include "describe/interface_document.h"

namespace zor2::describe {
namespace {

void SetOptional(xml::OutputElement* element, std::string_view name,
                 const std::optional<std::string>& value) {
  if (value) element->SetAttribute(name, *value);
}

void AddMethod(xml::OutputElement* parent, const MethodDescription& method) {
  xml::OutputElement* element = parent->AddChild("Method");
  element->SetAttribute("Name", method.name);
  element->SetAttribute("Access", method.access);
  element->SetAttribute("Type", method.type);
  SetOptional(element, "Property", method.property);
  SetOptional(element, "ReturnedType", method.returned_type);
  element->SetAttribute("Signature", method.signature);
  if (method.nodoc) element->SetAttribute("@nodoc", "Y");
  SetOptional(element, "Deprecated", method.deprecated);
  for (const ArgDescription& arg : method.args) {
    xml::OutputElement* arg_element = element->AddChild("Arg");
    arg_element->SetAttribute("Type", arg.type);
    arg_element->SetAttribute("Name", arg.name);
    SetOptional(arg_element, "Value", arg.value);
    if (arg.retval) arg_element->SetAttribute("Retval", "Y");
  }
}

}  // namespace

std::unique_ptr<xml::OutputElement> BuildDocument(const FrameworkDescription& framework) {
  auto root = std::make_unique<xml::OutputElement>("Workspace");
  xml::OutputElement* framework_element = root->AddChild("Framework");
  framework_element->SetAttribute("Name", framework.name);
  for (const GroupDescription& group : framework.groups) {
    xml::OutputElement* group_element = framework_element->AddChild("Interfaces");
    group_element->SetAttribute("Name", group.name);
    for (const FileDescription& file : group.files) {
      xml::OutputElement* file_element = group_element->AddChild("File");
      file_element->SetAttribute("Name", file.name);
      file_element->SetAttribute("Aut", file.aut);
      SetOptional(file_element, "@ZOR2Level", file.level);
      SetOptional(file_element, "@ZOR2Usage", file.usage);
      for (const ClassDescription& described : file.classes) {
        xml::OutputElement* class_element = file_element->AddChild("Class");
        class_element->SetAttribute("Name", described.name);
        class_element->SetAttribute("Aut", described.aut);
        SetOptional(class_element, "Deprecated", described.deprecated);
        for (const MethodDescription& method : described.methods) {
          AddMethod(class_element, method);
        }
      }
    }
  }
  return root;
}

}  // namespace zor2::describe
