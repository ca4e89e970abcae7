// Each change between the two releases of this header is either one no
// compiler can tell apart (no finding) or one every compiler can (a finding).
#pragma once
#include <cstdarg>
#include <cstddef>
#include <cstdint>
#include <ostream>
#include <string>

namespace lib {
inline namespace v11 {

typedef float value_t;
typedef unsigned char byte_t;

namespace detail {
template <typename Char>
struct args {
  using type = std::basic_string<Char>;
};
}  // namespace detail

class Image {
 public:
  byte_t* row(int y);
  const byte_t* row(int y) const;
  void write(std::basic_ostream<char, std::char_traits<char>>& out) const;
  void resize(size_t width, std::size_t height);
  void log(const char* format, va_list args);
  void set_flags(unsigned int flags, unsigned char mask);
  void scale(double factor);
  long area() const;
  std::size_t count() const;
  detail::args<char>::type title() const;
  template <typename S>
  void print(S& stream) const;
  template <typename... Args>
  void emit(const Args&... args);

  value_t gain() const;
  void crop(unsigned int columns);
  void label(const char* text);

 private:
  std::size_t count_ = 0;
};

}  // namespace v11
}  // namespace lib
