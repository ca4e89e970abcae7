// Where shapes are drawn.
#pragma once

#include <cstddef>
#include <vector>

#include "geometry/shape.h"

namespace geometry {
inline namespace v2 {

class Canvas {
 public:
  Canvas(std::size_t width, std::size_t height);

  void Draw(const Shape& shape, int layer = 1);
  std::size_t Count() const;
  const Shape* At(std::size_t index, const char* label = nullptr) const;

 private:
  std::vector<const Shape*> shapes_;
};

}  // namespace v2
}  // namespace geometry
