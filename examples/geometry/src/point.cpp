#include "geometry/point.h"

#include <cmath>

namespace geometry {

Point::Point(Real x, Real y) : x_(x), y_(y) {}

Real Point::X() const {
  return x_;
}

Real Point::Y() const {
  return y_;
}

Real Point::DistanceTo(const Point& other) const {
  return std::hypot(x_ - other.x_, y_ - other.y_);
}

}  // namespace geometry
