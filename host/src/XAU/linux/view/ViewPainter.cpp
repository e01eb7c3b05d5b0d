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
constexpr double kFootFontSize = 10.0;
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
    FillRectangle(context, kTrack, left, middle - kTrackHeight / 2.0, geometry.GetControlWidth(), kTrackHeight);
    FillRectangle(context, kFill, left, middle - kTrackHeight / 2.0, length, kTrackHeight);
    FillCircle(context, kFill, left + length, middle, kKnobRadius);
}

// Nothing to take hold of.
void DrawLevel(cairo_t* context, const ViewGeometry& geometry, const ParameterRow& row, double middle)
{
    const double left = geometry.GetControlLeft();
    FillRectangle(context, kTrack, left, middle - kTrackHeight, geometry.GetControlWidth(), 2.0 * kTrackHeight);
    FillRectangle(context, kIdle, left, middle - kTrackHeight, geometry.GetControlWidth() * row.GetPosition(),
                  2.0 * kTrackHeight);
}

void DrawSteps(cairo_t* context, const ViewGeometry& geometry, const ParameterRow& row, double top)
{
    const std::vector<std::string>& names = row.GetStepNames();
    const double width = geometry.GetControlWidth() / static_cast<double>(names.size());
    for (std::size_t step = 0; step < names.size(); ++step)
    {
        const bool isOn = step == row.GetStep();
        const double left = geometry.GetControlLeft() + width * static_cast<double>(step);
        FillRectangle(context, isOn ? kFill : kTrack, left, top + 3.0, width - kFieldSpacing,
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
    case ParameterRow::Control::Level:
        DrawLevel(context, geometry, row, middle);
        return;
    case ParameterRow::Control::None:
        return;
    }
}

void DrawScrollBar(cairo_t* context, const ViewGeometry& geometry)
{
    if (!geometry.IsScrolled())
        return;
    constexpr double kThickness = 4.0;
    const double length = geometry.height - ViewGeometry::kMargin - ViewGeometry::kFoot;
    const double perRow = length / static_cast<double>(geometry.rows);
    const double left = geometry.width - ViewGeometry::kMargin + kThickness / 2.0;
    FillRectangle(context, kTrack, left, ViewGeometry::kMargin, kThickness, length);
    FillRectangle(context, kIdle, left, ViewGeometry::kMargin + perRow * static_cast<double>(geometry.first),
                  kThickness, std::max(perRow * static_cast<double>(geometry.GetShown()), kThickness));
}

void DrawRemark(cairo_t* context, const ViewGeometry& geometry, const std::vector<const ParameterRow*>& shown)
{
    if (std::none_of(shown.begin(), shown.end(), [](const ParameterRow* row) { return row->IsNonRealTime(); }))
        return;
    cairo_set_font_size(context, kFootFontSize);
    const double top = geometry.height - (ViewGeometry::kFoot + ViewGeometry::kRowHeight) / 2.0;
    DrawText(context, kIdle, "* cannot be automated: change it while nothing plays", ViewGeometry::kMargin, top,
             geometry.width - ViewGeometry::kMargin - ViewGeometry::kGrip);
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

ViewGeometry ViewGeometry::Fit(std::size_t rows, int width, int height)
{
    const int room = std::clamp(height, 0, kMaxHeight) - kMargin - kFoot;
    const auto fitting = static_cast<std::size_t>(std::max(room, 0) / kRowHeight);
    const std::size_t shown = std::max<std::size_t>(std::min(rows, std::max(fitting, kMinRows)), 1);
    return {std::clamp(width, kMinWidth, kMaxWidth), kMargin + static_cast<int>(shown) * kRowHeight + kFoot, rows};
}

std::size_t ViewGeometry::GetShown() const
{
    return std::min(rows, static_cast<std::size_t>((height - kMargin - kFoot) / kRowHeight));
}

ViewGeometry ViewGeometry::ScrolledTo(std::ptrdiff_t row) const
{
    ViewGeometry scrolled = *this;
    const auto last = static_cast<std::ptrdiff_t>(rows - GetShown());
    scrolled.first = static_cast<std::size_t>(std::clamp<std::ptrdiff_t>(row, 0, last));
    return scrolled;
}

ViewGeometry ViewGeometry::ScrolledToBar(int y) const
{
    const double share = static_cast<double>(y - kMargin) / (height - kMargin - kFoot);
    const double row = share * static_cast<double>(rows) - static_cast<double>(GetShown()) / 2.0;
    return ScrolledTo(static_cast<std::ptrdiff_t>(row));
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

double ViewGeometry::GetRowTop(std::size_t place) const
{
    return kMargin + static_cast<double>(place) * kRowHeight;
}

std::optional<std::size_t> ViewGeometry::FindControl(int x, int y) const
{
    const bool isBeside = x < GetControlLeft() - kKnobRadius || x > GetTextLeft() - kGap;
    if (isBeside || y < kMargin)
        return std::nullopt;
    const auto place = static_cast<std::size_t>((y - kMargin) / kRowHeight);
    return place < GetShown() ? std::optional(first + place) : std::nullopt;
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

void PaintView(cairo_t* context, const ViewGeometry& geometry, const std::vector<const ParameterRow*>& shown)
{
    FillRectangle(context, kBackground, 0.0, 0.0, geometry.width, geometry.height);
    SetFont(context);
    const double nameWidth = geometry.GetControlLeft() - ViewGeometry::kMargin - kGap - kKnobRadius;
    const double textWidth = geometry.width - ViewGeometry::kMargin - geometry.GetTextLeft();
    for (std::size_t place = 0; place < shown.size(); ++place)
    {
        const ParameterRow& row = *shown[place];
        const double top = geometry.GetRowTop(place);
        if ((geometry.first + place) % 2 == 1)
            FillRectangle(context, kStripe, 0.0, top, geometry.width, ViewGeometry::kRowHeight);
        const std::string name = row.IsNonRealTime() ? "* " + row.GetName() : row.GetName();
        DrawText(context, kInk, name, ViewGeometry::kMargin, top, nameWidth);
        DrawControl(context, geometry, row, top);
        DrawText(context, kInk, row.GetText(), geometry.GetTextLeft(), top, textWidth);
    }
    if (shown.empty())
        DrawText(context, kInk, "This unit has no parameters.", ViewGeometry::kMargin, ViewGeometry::kMargin,
                 geometry.width - 2.0 * ViewGeometry::kMargin);
    DrawScrollBar(context, geometry);
    DrawRemark(context, geometry, shown);
    DrawGrip(context, geometry);
}

} // namespace zebaudiofilterhost::xau
