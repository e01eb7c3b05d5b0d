#pragma once

namespace zebcore::geom
{

/// Rectangle by its edges. Editor rectangles start at the origin, so that right is their width and bottom their
/// height. Default all zero.
template <class T>
struct RectT
{
    T left{};
    T top{};
    T right{};
    T bottom{};

    constexpr bool operator==(const RectT&) const = default;
};

} // namespace zebcore::geom
