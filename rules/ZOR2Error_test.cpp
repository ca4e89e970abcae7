#include "rules/ZOR2Error.h"

#include <gtest/gtest.h>

#include <cstdio>
#include <memory>
#include <string>
#include <vector>

#include "platform/tools/ZOROFStream.h"
#include "rules/MessageTypes.h"

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

TEST(MessageTypeRegistryTest, HoldsTheThirteenTypesInTheirFixedOrder) {
  const std::vector<std::string> codes = {"FHBD", "LHC",   "UHC",   "CHBD", "MHBDM",
                                          "NPVM", "ADVHC", "MRTHC", "INDM", "CINMA",
                                          "PMHC", "MOHBC", "ARVHC"};
  const MessageTypeRegistry& registry = MessageTypeRegistry::Get();
  ASSERT_EQ(registry.Count(), static_cast<int>(codes.size()));
  for (int i = 0; i < registry.Count(); ++i) {
    ASSERT_NE(registry.At(i), nullptr);
    EXPECT_EQ(registry.At(i)->code, codes[i]);
    EXPECT_EQ(registry.Find(codes[i].c_str()), registry.At(i));
  }
}

TEST(MessageTypeRegistryTest, AnswersNothingForOtherCodes) {
  const MessageTypeRegistry& registry = MessageTypeRegistry::Get();
  EXPECT_EQ(registry.Find("XYZ"), nullptr);
  EXPECT_EQ(registry.Find("fhbd"), nullptr);
  EXPECT_EQ(registry.Find(""), nullptr);
  EXPECT_EQ(registry.Find(nullptr), nullptr);
  EXPECT_EQ(registry.At(-1), nullptr);
  EXPECT_EQ(registry.At(registry.Count()), nullptr);
}

TEST(ZOR2ErrorTest, KnownCodeCarriesItsTypeInThreeAttributes) {
  std::unique_ptr<ZOR2Error> error;
  EXPECT_EQ(LoggedBy([&] { error = std::make_unique<ZOR2Error>("MRTHC"); }), "");
  ASSERT_NE(error->type(), nullptr);
  EXPECT_STREQ(error->getTag(), "Error");
  EXPECT_STREQ(error->getAttributeValue("ID"), "MRTHC");
  EXPECT_STREQ(error->getAttributeValue("FullName"), "Method Returned Type Has Changed");
  EXPECT_STREQ(error->getAttributeValue("Help"),
               "Returned Type of current method is different between reference WS and checked WS");

  std::string written;
  error->writeTo(written);
  EXPECT_NE(written.find("<Error ID=\"MRTHC\" FullName=\"Method Returned Type Has Changed\" Help="),
            std::string::npos);
}

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
  EXPECT_EQ(null->getFirstNodePosition(), nullptr);
}

TEST(AddErrorTest, AppendsTheErrorAsLastChild) {
  auto method = QEXVBTXMLNode::CreateNode("Method");
  QEXVBTXMLNode* parent = method.get();
  parent->insertNodeAtEnd(QEXVBTXMLNode::CreateNode("Arg"));
  ZOR2Error* first = AddError(parent, "ADVHC");
  ZOR2Error* second = AddError(parent, "NOPE");  // kept although unknown
  ASSERT_NE(first, nullptr);
  ASSERT_NE(second, nullptr);

  QEXVBTXMLPosition position = method->getFirstNodePosition();
  EXPECT_STREQ(method->getNextNode(position)->getTag(), "Arg");
  EXPECT_EQ(method->getNextNode(position), first);
  EXPECT_EQ(method->getNextNode(position), second);
  EXPECT_EQ(position, nullptr);
}

TEST(AddErrorTest, NullParentCreatesAndLogsNothing) {
  QEXVBTXMLNode* parent = nullptr;
  EXPECT_EQ(LoggedBy([&] { EXPECT_EQ(AddError(parent, "NOPE"), nullptr); }), "");
  EXPECT_EQ(LoggedBy([&] { EXPECT_EQ(AddError(parent, nullptr), nullptr); }), "");
}

}  // namespace
