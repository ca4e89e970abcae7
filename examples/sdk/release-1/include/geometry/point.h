// A point of the plane.
#pragma once

#include <cstddef>
#include <string>

namespace geometry {
inline namespace v1 {

class Point {
 public:
  Point(double x, double y);

  double X() const;
  double Y() const;
  double Distance(const Point& other) const;
  void Move(double dx, double dy = 0.0);
  std::string Format(std::size_t precision) const;

  double* Coordinates();
  const double* Coordinates() const;

 private:
  double xy_[2];
};

}  // namespace v1
}  // namespace geometry
