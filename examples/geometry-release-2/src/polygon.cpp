#include "geometry/polygon.h"

#include <cmath>

namespace geometry {

Polygon::Polygon(std::span<const Point> vertices) : vertices_(vertices.begin(), vertices.end()) {}

int Polygon::VertexCount() const {
  return static_cast<int>(vertices_.size());
}

Real Polygon::Perimeter() const {
  Real perimeter = 0;
  for (std::size_t i = 0; i < vertices_.size(); ++i) {
    perimeter += vertices_[i].DistanceTo(vertices_[(i + 1) % vertices_.size()]);
  }
  return perimeter;
}

// The shoelace formula.
Real Polygon::Area() const {
  Real twice_area = 0;
  for (std::size_t i = 0; i < vertices_.size(); ++i) {
    const Point& a = vertices_[i];
    const Point& b = vertices_[(i + 1) % vertices_.size()];
    twice_area += a.X() * b.Y() - b.X() * a.Y();
  }
  return std::abs(twice_area) / 2;
}

}  // namespace geometry
