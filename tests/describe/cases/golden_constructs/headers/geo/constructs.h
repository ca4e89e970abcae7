// One header that holds every construct zor2describe describes.
// @ZOR2Level L1
/* @ZOR2Usage U2 */
#pragma once

#include <cstddef>
#include <string>
#include <vector>

#define GEO_GETTER(Type, Name) Type Get##Name() const

namespace geo {

struct GeoPoint {
  double x = 0;
  double y = 0;
};

/// A shape of the model.
/// @ZOR2Aut
class GeoShape {
 public:
  GeoShape();
  explicit GeoShape(const std::string& iName, int iSides = 2 * 3 + 1,
                    double iScale = 1.0 / 3);
  GeoShape(const GeoShape&) = delete;
  virtual ~GeoShape();

  // @ZOR2Property R
  double Distance(const GeoPoint & iOther) const;
  /// @ZOR2Retval oArea
  virtual int Area(const std::vector<GeoPoint>& iPoints,
                   double& oArea) const = 0;
  static long Count(unsigned long long iMask, ...);

  // Const twins.
  GeoPoint* FirstPoint();
  const GeoPoint* FirstPoint() const;
  // Ref-qualified twins.
  std::string& Name() &;
  std::string&& Name() &&;

  bool operator==(const GeoShape& iOther) const;
  GeoPoint& operator[](std::size_t iIndex);
  GeoShape& operator=(const GeoShape&) = delete;
  explicit operator bool() const;

  template <typename Visitor, int Depth = 1>
  void Visit(Visitor iVisitor, const char* iLabel = "shape  (all)");

  GEO_GETTER(int, Sides);

  // Hidden from the documentation. @nodoc
  void Refresh();
  [[deprecated("since M4R18: use Distance")]] double Length() const;
  [[deprecated]] void Reset();
  /// @deprecated M4R19
  void Clear(int iFlags = Flags(1 << 2, /* keep */ true));

  class Iterator {
   public:
    GeoPoint operator*() const;
    Iterator& operator++();
  };

 protected:
  virtual void OnChange(const GeoPoint& iWhere) {}
  static int Flags(int iBits, bool iKeep);

 private:
  void Normalize();
  std::string name_;
};

class GeoCircle final : public GeoShape {
 public:
  int Area(const std::vector<GeoPoint>& iPoints, double& oArea) const override;

 protected:
  void OnChange(const GeoPoint& iWhere) override;
};

/// @deprecated M4R17
template <typename T, std::size_t N = 4>
class [[deprecated("M4R18")]] GeoBuffer {
 public:
  GeoBuffer(const T& iFill = T());
  T& At(std::size_t iIndex);
  const T& At(std::size_t iIndex) const;
  std::vector<T> Values() const;
  template <typename U>
  static GeoBuffer<U, N> Convert(const GeoBuffer& iOther);

  struct Slot {
    T value;
    void Assign(const T& iValue);
  };
};

template <typename T>
class GeoBuffer<T*, 2> {
 public:
  T* Get() const;
};

template <>
class GeoBuffer<bool, 8> {
 public:
  bool Get(int iBit) const;
};

union GeoValue {
  int i;
  double d;
  int AsInt() const;
};

/// @ZOR2Retval oLength
double Measure(const GeoShape& iShape, double* oLength = nullptr);
GeoShape* Make(const std::string& iName = std::string("unnamed"));
GeoShape* Make(int iSides);
void Forget(GeoShape*) = delete;
double Measure(const GeoShape& iShape, double* oLength);

namespace io {
bool Save(const GeoShape& iShape, const std::string& iPath, int iFlags = 0x10 | 0x01);
template <typename Stream>
Stream& operator<<(Stream& ioStream, const GeoPoint& iPoint);
}  // namespace io

namespace {
void Hidden();
struct HiddenShape {
  void Draw();
};
}  // namespace

}  // namespace geo

extern "C" int geo_version(void);
int GeoMain(int argc, char** argv);
