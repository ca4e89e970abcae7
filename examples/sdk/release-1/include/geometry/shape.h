// The shapes a canvas draws; clients derive their own.
#pragma once

#include <string>

#include "geometry/point.h"

namespace geometry {
inline namespace v1 {

class Shape {
 public:
  Shape() = default;
  virtual ~Shape();

  virtual double Area() const = 0;
  virtual std::string Name() const;
  virtual void Translate(const Point& by);
};

class Circle : public Shape {
 public:
  Circle(const Point& center, double radius);
  double Area() const override;
  double Radius() const;
};

}  // namespace v1
}  // namespace geometry
