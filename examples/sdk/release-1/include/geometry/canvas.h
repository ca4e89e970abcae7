// Where shapes are drawn.
#pragma once

#include <cstddef>
#include <vector>

#include "geometry/shape.h"

namespace geometry {
inline namespace v1 {

class Canvas {
 public:
  Canvas(std::size_t width, std::size_t height);

  void Draw(const Shape& shape, int layer = 0);
  void Clear();
  std::size_t Count() const;
  const Shape* At(std::size_t index, const char* label = NULL) const;

 private:
  std::vector<const Shape*> shapes_;
};

class Layer {
 public:
  explicit Layer(int depth);
  int Depth() const;
};

}  // namespace v1
}  // namespace geometry
