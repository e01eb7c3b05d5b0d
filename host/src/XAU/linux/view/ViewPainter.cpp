#include "host/src/XAU/linux/view/ViewPainter.h"

#include <algorithm>
#include <cmath>

namespace zebaudiofilterhost::xau
{

namespace
{

constexpr double kNameShare = 0.34; // of the width, for names; then controls; texts have the rest
constexpr double kTextShare = 0.24;
constexpr double kGap = 8.0;
constexpr double kFontSize = 12.0;
constexpr double kTrackHeight = 6.0;
constexpr double kKnobRadius = 7.0;
constexpr std::size_t kMaxFields = 8; // of steps
constexpr double kFieldMargin = 4.0;  // left of a field's text
constexpr double kFieldSpacing = 1.0; // right of a field
constexpr double kPi = 3.14159265358979323846;

struct Colour
{
    double red;
    double green;
    double blue;
};

constexpr Colour kBackground{0.96, 0.96, 0.95};
constexpr Colour kStripe{0.92, 0.92, 0.91};
constexpr Colour kInk{0.13, 0.14, 0.16};
constexpr Colour kTrack{0.78, 0.79, 0.80};
constexpr Colour kFill{0.16, 0.44, 0.72};
constexpr Colour kIdle{0.60, 0.62, 0.64}; // of what cannot be changed
constexpr Colour kPaper{1.0, 1.0, 1.0};

void SetColour(cairo_t* context, const Colour& colour)
{
    cairo_set_source_rgb(context, colour.red, colour.green, colour.blue);
}

void FillRectangle(cairo_t* context, const Colour& colour, double left, double top, double width, double height)
{
    SetColour(context, colour);
    cairo_rectangle(context, left, top, width, height);
    cairo_fill(context);
}

void FillCircle(cairo_t* context, const Colour& colour, double x, double y, double radius)
{
    SetColour(context, colour);
    cairo_arc(context, x, y, radius, 0.0, 2.0 * kPi);
    cairo_fill(context);
}

void SetFont(cairo_t* context)
{
    cairo_select_font_face(context, "sans-serif", CAIRO_FONT_SLANT_NORMAL, CAIRO_FONT_WEIGHT_NORMAL);
    cairo_set_font_size(context, kFontSize);
}

// Pixels. Not on the view's surface: a click asks as well, and must get the answer that was drawn.
double MeasureWidest(const std::vector<std::string>& texts)
{
    cairo_surface_t* surface = cairo_image_surface_create(CAIRO_FORMAT_A8, 1, 1);
    cairo_t* context = cairo_create(surface);
    SetFont(context);
    double widest = 0.0;
    for (const std::string& text : texts)
    {
        cairo_text_extents_t extents = {};
        cairo_text_extents(context, text.c_str(), &extents);
        widest = std::max(widest, extents.x_advance);
    }
    cairo_destroy(context);
    cairo_surface_destroy(surface);
    return widest;
}

// Cut at the right end of its field.
void DrawText(cairo_t* context, const Colour& colour, const std::string& text, double left, double top, double width)
{
    cairo_save(context);
    cairo_rectangle(context, left, top, width, ViewGeometry::kRowHeight);
    cairo_clip(context);
    cairo_font_extents_t font = {};
    cairo_font_extents(context, &font);
    const double baseline = top + (ViewGeometry::kRowHeight + font.ascent - font.descent) / 2.0;
    SetColour(context, colour);
    cairo_move_to(context, left, baseline);
    cairo_show_text(context, text.c_str());
    cairo_restore(context);
}

void DrawSlider(cairo_t* context, const ViewGeometry& geometry, const ParameterRow& row, double middle)
{
    const double left = geometry.GetControlLeft();
    const double length = geometry.GetControlWidth() * row.GetPosition();
    const Colour& colour = row.IsWritable() ? kFill : kIdle;
    FillRectangle(context, kTrack, left, middle - kTrackHeight / 2.0, geometry.GetControlWidth(), kTrackHeight);
    FillRectangle(context, colour, left, middle - kTrackHeight / 2.0, length, kTrackHeight);
    if (row.IsWritable())
        FillCircle(context, colour, left + length, middle, kKnobRadius);
}

void DrawSteps(cairo_t* context, const ViewGeometry& geometry, const ParameterRow& row, double top)
{
    const std::vector<std::string>& names = row.GetStepNames();
    const double width = geometry.GetControlWidth() / static_cast<double>(names.size());
    for (std::size_t step = 0; step < names.size(); ++step)
    {
        const bool isOn = step == row.GetStep();
        const double left = geometry.GetControlLeft() + width * static_cast<double>(step);
        const Colour& on = row.IsWritable() ? kFill : kIdle;
        FillRectangle(context, isOn ? on : kTrack, left, top + 3.0, width - kFieldSpacing,
                      ViewGeometry::kRowHeight - 6.0);
        DrawText(context, isOn ? kPaper : kInk, names[step], left + kFieldMargin, top,
                 width - kFieldMargin - kFieldSpacing);
    }
}

void DrawSwitch(cairo_t* context, const ViewGeometry& geometry, const ParameterRow& row, double middle)
{
    constexpr double kLength = 34.0;
    const bool isOn = row.GetPosition() >= 0.5;
    const double left = geometry.GetControlLeft() + kKnobRadius;
    FillRectangle(context, isOn ? kFill : kTrack, left, middle - kKnobRadius, kLength, 2.0 * kKnobRadius);
    FillCircle(context, isOn ? kFill : kTrack, left, middle, kKnobRadius);
    FillCircle(context, isOn ? kFill : kTrack, left + kLength, middle, kKnobRadius);
    FillCircle(context, kPaper, isOn ? left + kLength : left, middle, kKnobRadius - 2.0);
}

void DrawControl(cairo_t* context, const ViewGeometry& geometry, const ParameterRow& row, double top)
{
    const double middle = top + ViewGeometry::kRowHeight / 2.0;
    switch (row.GetControl())
    {
    case ParameterRow::Control::Slider:
        DrawSlider(context, geometry, row, middle);
        return;
    case ParameterRow::Control::Steps:
        if (HasStepFields(geometry, row))
            DrawSteps(context, geometry, row, top);
        else
            DrawSlider(context, geometry, row, middle);
        return;
    case ParameterRow::Control::Switch:
        DrawSwitch(context, geometry, row, middle);
        return;
    }
}

void DrawGrip(cairo_t* context, const ViewGeometry& geometry)
{
    SetColour(context, kIdle);
    cairo_set_line_width(context, 1.0);
    constexpr int kFirst = 3;
    constexpr int kApart = 4;
    for (int inset = kFirst; inset < ViewGeometry::kGrip; inset += kApart)
    {
        cairo_move_to(context, geometry.width - inset, geometry.height);
        cairo_line_to(context, geometry.width, geometry.height - inset);
    }
    cairo_stroke(context);
}

} // namespace

ViewGeometry ViewGeometry::Fit(std::size_t rows, int width)
{
    const auto shown = static_cast<int>(std::max<std::size_t>(rows, 1));
    return {std::max(width, kMinWidth), 2 * kMargin + shown * kRowHeight, rows};
}

double ViewGeometry::GetControlLeft() const
{
    return kMargin + kNameShare * (width - 2 * kMargin);
}

double ViewGeometry::GetControlWidth() const
{
    return GetTextLeft() - 2.0 * kGap - GetControlLeft();
}

double ViewGeometry::GetTextLeft() const
{
    return width - kMargin - kTextShare * (width - 2 * kMargin);
}

double ViewGeometry::GetRowTop(std::size_t row) const
{
    return kMargin + static_cast<double>(row) * kRowHeight;
}

std::optional<std::size_t> ViewGeometry::FindControl(int x, int y) const
{
    const bool isBeside = x < GetControlLeft() - kKnobRadius || x > GetTextLeft() - kGap;
    if (isBeside || y < kMargin)
        return std::nullopt;
    const auto row = static_cast<std::size_t>((y - kMargin) / kRowHeight);
    return row < rows ? std::optional(row) : std::nullopt;
}

bool ViewGeometry::IsGrip(int x, int y) const
{
    return x >= width - kGrip && y >= height - kGrip;
}

double ViewGeometry::GetPosition(int x) const
{
    return std::clamp((x - GetControlLeft()) / GetControlWidth(), 0.0, 1.0);
}

bool HasStepFields(const ViewGeometry& geometry, const ParameterRow& row)
{
    const std::vector<std::string>& names = row.GetStepNames();
    if (row.GetControl() != ParameterRow::Control::Steps || names.empty() || names.size() > kMaxFields)
        return false;
    const double width = geometry.GetControlWidth() / static_cast<double>(names.size());
    return MeasureWidest(names) <= width - kFieldMargin - kFieldSpacing;
}

void PaintView(cairo_t* context, const ViewGeometry& geometry, const std::vector<ParameterRow>& rows)
{
    FillRectangle(context, kBackground, 0.0, 0.0, geometry.width, geometry.height);
    SetFont(context);
    const double nameWidth = geometry.GetControlLeft() - ViewGeometry::kMargin - kGap - kKnobRadius;
    const double textWidth = geometry.width - ViewGeometry::kMargin - geometry.GetTextLeft();
    for (std::size_t index = 0; index < rows.size(); ++index)
    {
        const double top = geometry.GetRowTop(index);
        if (index % 2 == 1)
            FillRectangle(context, kStripe, 0.0, top, geometry.width, ViewGeometry::kRowHeight);
        DrawText(context, kInk, rows[index].GetName(), ViewGeometry::kMargin, top, nameWidth);
        DrawControl(context, geometry, rows[index], top);
        DrawText(context, kInk, rows[index].GetText(), geometry.GetTextLeft(), top, textWidth);
    }
    if (rows.empty())
        DrawText(context, kInk, "This unit has no parameters.", ViewGeometry::kMargin, ViewGeometry::kMargin,
                 geometry.width - 2.0 * ViewGeometry::kMargin);
    DrawGrip(context, geometry);
}

} // namespace zebaudiofilterhost::xau
