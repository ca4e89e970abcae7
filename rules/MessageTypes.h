#pragma once

#include <string>

// One of the thirteen message types: the short code that rules report, its
// full name and its HTML help text. Instances live for the whole process.
struct ZOR2ErrorType {
  const char* code;
  const char* fullName;
  const char* help;
};

// The registry of message types, keyed by code, in registration order. Filled
// once, before main runs, with the thirteen types in their fixed order; a
// null, empty or repeated code aborts the process.
class MessageTypeRegistry {
 public:
  static const MessageTypeRegistry& Get();
  // The type registered under `code`, or null.
  const ZOR2ErrorType* Find(const char* code) const;
  int Count() const;
  // Position from 0 to Count() - 1, in registration order.
  const ZOR2ErrorType* At(int position) const;
};
