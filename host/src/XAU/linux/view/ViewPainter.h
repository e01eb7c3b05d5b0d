#pragma once

#include "host/src/XAU/linux/view/ParameterRow.h"

#include <cairo.h>

#include <optional>
#include <vector>

namespace zebaudiofilterhost::xau
{

/// Where the parts of a view of rows lie, in pixels.
struct ViewGeometry
{
    static constexpr int kRowHeight = 26;
    static constexpr int kMargin = 10;
    static constexpr int kGrip = 14; // the corner that resizes the view
    static constexpr int kMinWidth = 320;

    int width;
    int height;
    std::size_t rows;

    static ViewGeometry Fit(std::size_t rows, int width);

    double GetControlLeft() const;
    double GetControlWidth() const;
    double GetTextLeft() const;
    double GetRowTop(std::size_t row) const;

    /// The row whose control is at that place.
    std::optional<std::size_t> FindControl(int x, int y) const;
    bool IsGrip(int x, int y) const;
    /// 0 to 1 along the control; beyond it the nearer end.
    double GetPosition(int x) const;
};

/// Whether a row has a field for each of its steps: few, and each text fits. Otherwise they are a slider. [main]
bool HasStepFields(const ViewGeometry& geometry, const ParameterRow& row);

/// Draws all rows. [main]
void PaintView(cairo_t* context, const ViewGeometry& geometry, const std::vector<ParameterRow>& rows);

} // namespace zebaudiofilterhost::xau
