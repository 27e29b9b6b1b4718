#pragma once

#include <cstddef>
#include <vector>

namespace ryn {

/// A plane of values: x is the fast index. Element (x, y) lies at (x - x0) + (y - y0) * nx, where
/// (x0, y0) is the origin. A copy is a deep one.
template <typename Value>
class CQxArray2D {
  public:
    CQxArray2D() = default;
    /// Sizes below 1 make an empty array.
    CQxArray2D(int sizeX, int sizeY, Value value, int originX = 0, int originY = 0)
        : x0(originX),
          y0(originY),
          nx(sizeX > 0 && sizeY > 0 ? sizeX : 0),
          ny(sizeX > 0 && sizeY > 0 ? sizeY : 0),
          values(static_cast<std::size_t>(nx) * static_cast<std::size_t>(ny), value) {}

    int SizeX() const { return nx; }
    int SizeY() const { return ny; }
    bool Contains(int x, int y) const { return x >= x0 && y >= y0 && x - x0 < nx && y - y0 < ny; }

    /// The place must be within the array.
    Value& operator()(int x, int y) { return values[Place(x, y)]; }
    const Value& operator()(int x, int y) const { return values[Place(x, y)]; }

    /// All values, SizeX() * SizeY() of them.
    Value* Data() { return values.data(); }
    const Value* Data() const { return values.data(); }
    std::size_t Size() const { return values.size(); }

  private:
    std::size_t Place(int x, int y) const {
        return static_cast<std::size_t>(x - x0) +
               static_cast<std::size_t>(y - y0) * static_cast<std::size_t>(nx);
    }

    int x0 = 0;
    int y0 = 0;
    int nx = 0;
    int ny = 0;
    std::vector<Value> values;
};

} // namespace ryn
