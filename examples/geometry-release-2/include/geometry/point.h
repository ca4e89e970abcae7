// A point of the plane.
// @ZOR2Usage U1
#pragma once

namespace geometry {

// The type of every coordinate, chosen when the library is built.
using Real = GEOMETRY_REAL;

class Point {
 public:
  Point(Real x, Real y);

  Real X() const;
  Real Y() const;
  Real DistanceTo(const Point& other) const;
  Point Translated(Real dx, Real dy) const;

 private:
  Real x_;
  Real y_;
};

}  // namespace geometry
