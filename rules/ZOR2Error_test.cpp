#include "rules/ZOR2Error.h"

#include <gtest/gtest.h>

#include <memory>
#include <string>

#include "platform/tools/ZOROFStream.h"

namespace {

// What `action` writes to the standard log stream.
template <typename Action>
std::string LoggedBy(Action action) {
  ZORout.flush();
  testing::internal::CaptureStdout();
  action();
  ZORout.flush();
  return testing::internal::GetCapturedStdout();
}

// Errors built from known codes, and the registry's order and texts, are in
// every end-to-end report and help page.
TEST(ZOR2ErrorTest, UnknownOrNullCodeGivesABareElementAndALogLine) {
  std::unique_ptr<ZOR2Error> unknown;
  EXPECT_EQ(LoggedBy([&] { unknown = std::make_unique<ZOR2Error>("XYZ"); }),
            " ZOR2Error::ZOR2Error, type not known : XYZ\n");
  EXPECT_EQ(unknown->type(), nullptr);
  EXPECT_EQ(unknown->getAttributeValue("ID"), nullptr);
  std::unique_ptr<ZOR2Error> null;
  EXPECT_EQ(LoggedBy([&] { null = std::make_unique<ZOR2Error>(nullptr); }),
            " ZOR2Error::ZOR2Error, type is null\n");
  EXPECT_EQ(null->type(), nullptr);
}

TEST(AddErrorTest, AppendsTheErrorAsLastChildUnlessThereIsNoParent) {
  auto method = QEXVBTXMLNode::CreateNode("Method");
  QEXVBTXMLNode* parent = method.get();
  parent->insertNodeAtEnd(QEXVBTXMLNode::CreateNode("Arg"));
  ZOR2Error* first = AddError(parent, "ADVHC");
  QEXVBTXMLPosition position = method->getFirstNodePosition();
  method->getNextNode(position);
  EXPECT_EQ(method->getNextNode(position), first);
  EXPECT_EQ(position, nullptr);
  parent = nullptr;
  EXPECT_EQ(LoggedBy([&] { EXPECT_EQ(AddError(parent, "NOPE"), nullptr); }), "");
}

}  // namespace
