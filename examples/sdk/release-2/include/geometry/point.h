// A point of the plane.
#pragma once

#include <cstddef>
#include <string>

namespace geometry {
inline namespace v2 {

class Point {
 public:
  Point(double x, double y);

  double X() const;
  double Y() const;
  float Distance(const Point& to) const;
  void Move(double dx, double dy = 0.0);
  std::string Format(size_t digits) const;
  Point Mirrored() const;

  double* Coordinates();
  const double* Coordinates() const;

 private:
  double xy_[2];
};

}  // namespace v2
}  // namespace geometry
