// A closed polygon.
// @ZOR2Usage U1
#pragma once

#include <cstddef>
#include <span>
#include <vector>

#include "geometry/point.h"

namespace geometry {

class Polygon {
 public:
  explicit Polygon(std::span<const Point> vertices);

  std::size_t VertexCount() const;
  Real Perimeter() const;
  Real Area() const;

 private:
  std::vector<Point> vertices_;
};

}  // namespace geometry
