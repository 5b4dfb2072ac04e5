#pragma once

#include <tuple>

#include <velkcore/Geometry.h>
#include <velkui/pictel/PictelHandles.h>

namespace velkui {

// The y at which text drawn with `font` sits vertically centred in `rect`,
// rounded to a whole unit (halves away from zero).
float GetFontBaseline(const pictel::FontP& font, const velkcore::RectT<float>& rect);

// Replaces *path with a new path holding the ellipse inscribed in `rect`.
void GetEllipsePath(const pictel::SupplierInterface* supplier, const velkcore::RectT<float>& rect,
                    pictel::PathP* path);
// Replaces *path with a new path holding `rect` with circular corners of `radius`
// (limited to half the shorter side).
void GetRoundedRectPath(const pictel::SupplierInterface* supplier,
                        const velkcore::RectT<float>& rect, float radius, pictel::PathP* path);

}  // namespace velkui

namespace velkui::utils {

// Which corners FormRoundedRect rounds: top-left, top-right, bottom-right, bottom-left.
using RoundedCorners = std::tuple<bool, bool, bool, bool>;

// Add a closed figure to an existing path.
void FormRect(pictel::PathP& path, const velkcore::RectT<float>& rect);
void FormRoundedRect(pictel::PathP& path, const velkcore::RectT<float>& rect, float radius);
void FormRoundedRect(pictel::PathP& path, const velkcore::RectT<float>& rect, float radius,
                     const RoundedCorners& corners);

}  // namespace velkui::utils
