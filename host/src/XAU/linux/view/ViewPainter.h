#pragma once

#include "host/src/XAU/linux/view/ParameterRow.h"

#include <cairo.h>

#include <cstddef>
#include <optional>
#include <vector>

namespace zebaudiofilterhost::xau
{

/// Where the parts of a view of rows lie, in pixels. More rows than there is room for are scrolled through.
struct ViewGeometry
{
    static constexpr int kRowHeight = 26;
    static constexpr int kMargin = 10;
    static constexpr int kFoot = 20; // below the rows, for a remark
    static constexpr int kGrip = 14; // the corner that resizes the view
    static constexpr int kMinWidth = 320;
    static constexpr int kMaxWidth = 4096;
    static constexpr int kMaxHeight = 4096;
    static constexpr std::size_t kMinRows = 3;

    int width = 0;
    int height = 0;
    std::size_t rows = 0;
    std::size_t first = 0; // of the rows shown

    /// As large as said at most, where the rows and the bounds above let it be so.
    static ViewGeometry Fit(std::size_t rows, int width, int height);

    std::size_t GetShown() const;
    bool IsScrolled() const { return GetShown() < rows; }
    /// The same with another first row, or with the nearest that there can be.
    ViewGeometry ScrolledTo(std::ptrdiff_t row) const;
    bool IsScrollBar(int x) const { return IsScrolled() && x >= width - kMargin; }
    /// With the middle of its thumb there.
    ViewGeometry ScrolledToBar(int y) const;

    double GetControlLeft() const;
    double GetControlWidth() const;
    double GetTextLeft() const;
    /// Of a place among the rows shown.
    double GetRowTop(std::size_t place) const;

    /// The row whose control is at that place.
    std::optional<std::size_t> FindControl(int x, int y) const;
    bool IsGrip(int x, int y) const;
    /// 0 to 1 along the control; beyond it the nearer end.
    double GetPosition(int x) const;
};

/// Whether a row has a field for each of its steps: few, and each text fits. Otherwise they are a slider. [main]
bool HasStepFields(const ViewGeometry& geometry, const ParameterRow& row);

/// Draws the rows shown. [main]
void PaintView(cairo_t* context, const ViewGeometry& geometry, const std::vector<const ParameterRow*>& shown);

} // namespace zebaudiofilterhost::xau
