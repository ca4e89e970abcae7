// The shapes a canvas draws; clients derive their own.
#pragma once

#include <string>

#include "geometry/point.h"

namespace geometry {
inline namespace v2 {

class Shape {
 public:
  Shape() = default;
  virtual ~Shape();

  virtual double Area() const = 0;
  virtual double Perimeter() const = 0;
  virtual std::string Name() const;
  virtual void Translate(const Point& by);
};

class Circle : public Shape {
 public:
  Circle(const Point& center, double radius);
  double Area() const override;
  double Perimeter() const override;
  double Radius() const;
};

}  // namespace v2
}  // namespace geometry
