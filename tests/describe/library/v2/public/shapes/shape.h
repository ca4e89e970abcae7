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
  virtual double Perimeter() const = 0;
  virtual std::string Name() const;
  void Render(int iQuality = 2);
  // Kept for old clients only. @nodoc
  void Hide();
  void Update();
  void Show();
  void Flash();
  void Resize(double iW, double iH);
  Point* Anchor();
  const Point* Anchor() const;
  void Blur(int iRadius = 1 + 2);

 private:
  void Refresh();
};

std::string Describe(const Shape& iShape);

}  // namespace shapes
