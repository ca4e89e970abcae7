// Points of the plane.
// @ZOR2Level L1
// @ZOR2Usage U1
#pragma once

namespace shapes {

/// A point, scriptable.
/// @ZOR2Aut
class Point {
 public:
  Point();
  Point(double iX, double iY);

  /// @ZOR2Property R
  double X() const;
  /// @ZOR2Property P
  double Y() const;
  void Move(double iDx, double iDy = 0.0);
  double Distance(const Point& iOther) const;
  void Scale(double iFactor);
  /// @ZOR2Retval oX
  void Get(double& oX, double& oY) const;
  int Quadrant() const;
  bool IsOrigin() const;

 private:
  double x_ = 0;
  double y_ = 0;
};

}  // namespace shapes
