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
  /// @ZOR2Property R
  double Y() const;
  void Move(double iDx, double iDy = 1.0);
  float Distance(const Point& iOther) const;
  void Scale(float iFactor);
  /// @ZOR2Retval oY
  void Get(double& oX, double& oY) const;
  bool IsOrigin() const;
  int Quadrant() const;

 private:
  double x_ = 0;
  double y_ = 0;
};

}  // namespace shapes
