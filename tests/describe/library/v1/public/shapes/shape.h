// The base of every shape.
// @ZOR2Level L1
// @ZOR2Usage U2
#pragma once

#include <string>
#include <vector>

#include "shapes/point.h"

namespace shapes {

class Shape {
 public:
  virtual ~Shape();
  virtual double Area() const = 0;
  virtual std::string Name() const;
  void Render(int iQuality = 2);
  void Hide();
  void Show();
  void Update();
  void Resize(double iWidth, double iHeight);
  Point* Anchor();
  void Blur(int iRadius = 1+2);
  [[deprecated("since M4R18, use Render")]] void Draw();
  /// @deprecated M4R19
  void Paint();
  void Blink();

 private:
  void Invalidate();
};

double TotalArea(const std::vector<Shape*>& iShapes);
std::string Describe(const Shape& iShape);

}  // namespace shapes
