// Texts printed from the syntax tree: template heads whose parameter comes
// from a macro, constructor templates, default values that call macros or
// spell a null pointer, and classes that a macro generates.
#pragma once
#include <cstddef>
#include <type_traits>

#define LIB_ENABLE_IF(...) typename std::enable_if<(__VA_ARGS__), int>::type = 0
#define LIB_TEXT(s) s
#define LIB_DECLARE_POINT(Name)       \
  class Name {                        \
   public:                            \
    Name(int x, int y);               \
    void Move(int dx, int dy = 0);    \
    void Place(const char* where);    \
  };

namespace lib {

template <typename OutputIt, LIB_ENABLE_IF(std::is_pointer<OutputIt>::value)>
OutputIt Copy(OutputIt out, const char* separator = LIB_TEXT("\t"));

class Buffer {
 public:
  template <typename T>
  Buffer(T* data, std::size_t size);
  void Reset(char* data = NULL, int* sizes = 0, void* owner = nullptr);
  void Fill(int value = 7);
  void Frame(const char* open = LIB_TEXT("["), const char* close = LIB_TEXT("]"));
};

LIB_DECLARE_POINT(Point)
LIB_DECLARE_POINT(Size)

}  // namespace lib
