// Helpers kept for older clients.
#pragma once

namespace geometry {
inline namespace v1 {

double DegreesToRadians(double degrees);

}  // namespace v1
}  // namespace geometry
