// Each change between the two releases of this header is either one no
// compiler can tell apart (no finding) or one every compiler can (a finding).
#pragma once
#include <cstdarg>
#include <cstddef>
#include <cstdint>
#include <ostream>
#include <string>

namespace lib {
inline namespace v12 {

typedef int value_t;
typedef std::uint8_t byte_t;

namespace detail {
template <typename Char>
struct args {
  using type = std::basic_string<Char>;
};
}  // namespace detail

class Image {
 public:
  byte_t* row(int line);
  const byte_t* row(int line) const;
  void write(std::ostream& out) const;
  void resize(std::size_t width, size_t height);
  void log(const char* format, std::va_list args);
  void set_flags(std::uint32_t flags, uint8_t mask);
  void scale(const double factor);
  auto area() const -> decltype(0L);
  auto count() const { return count_; }
  std::string title() const;
  template <typename Stream>
  void print(Stream& stream) const;
  template <typename... T>
  void emit(const T&... args);

  value_t gain() const;
  void crop(std::size_t columns);
  void label(std::string text);

 private:
  std::size_t count_ = 0;
};

}  // namespace v12
}  // namespace lib
