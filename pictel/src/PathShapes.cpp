#include <velkui/pictel/PathShapes.h>

#include <algorithm>
#include <cmath>

#include <velkcore/Error.h>

namespace velkui {

using pictel::PathP;
using velkcore::PointT;
using velkcore::RectT;

namespace {

// Distance of a quarter circle's control points from its ends, per unit radius.
constexpr float kQuarterArcKappa = 0.55228475f;

bool HasArea(const RectT<float>& rect) {
  return rect.width > 0.0f && rect.height > 0.0f;
}

void AddEllipse(pictel::PathInterface& path, const RectT<float>& rect) {
  const float rx = rect.width * 0.5f;
  const float ry = rect.height * 0.5f;
  const float cx = rect.left + rx;
  const float cy = rect.top + ry;
  const float kx = rx * kQuarterArcKappa;
  const float ky = ry * kQuarterArcKappa;
  path.MoveTo(PointT<float>{cx + rx, cy});
  path.BezierTo(PointT<float>{cx + rx, cy + ky}, PointT<float>{cx + kx, cy + ry},
                PointT<float>{cx, cy + ry});
  path.BezierTo(PointT<float>{cx - kx, cy + ry}, PointT<float>{cx - rx, cy + ky},
                PointT<float>{cx - rx, cy});
  path.BezierTo(PointT<float>{cx - rx, cy - ky}, PointT<float>{cx - kx, cy - ry},
                PointT<float>{cx, cy - ry});
  path.BezierTo(PointT<float>{cx + kx, cy - ry}, PointT<float>{cx + rx, cy - ky},
                PointT<float>{cx + rx, cy});
  path.Close();
}

// Clockwise from the top edge; a corner whose flag is clear stays square.
void AddRoundedRect(pictel::PathInterface& path, const RectT<float>& rect, float radius,
                    const utils::RoundedCorners& corners) {
  const float r = std::clamp(radius, 0.0f, std::min(rect.width, rect.height) * 0.5f);
  if (!(r > 0.0f)) {
    path.AddRect(rect);
    return;
  }
  const auto [topLeft, topRight, bottomRight, bottomLeft] = corners;
  const float left = rect.left;
  const float top = rect.top;
  const float right = rect.Right();
  const float bottom = rect.Bottom();

  path.MoveTo(PointT<float>{topLeft ? left + r : left, top});
  if (topRight) {
    path.AddArc(PointT<float>{right - r, top + r}, r, 270.0f, 90.0f);
  } else {
    path.LineTo(PointT<float>{right, top});
  }
  if (bottomRight) {
    path.AddArc(PointT<float>{right - r, bottom - r}, r, 0.0f, 90.0f);
  } else {
    path.LineTo(PointT<float>{right, bottom});
  }
  if (bottomLeft) {
    path.AddArc(PointT<float>{left + r, bottom - r}, r, 90.0f, 90.0f);
  } else {
    path.LineTo(PointT<float>{left, bottom});
  }
  if (topLeft) {
    path.AddArc(PointT<float>{left + r, top + r}, r, 180.0f, 90.0f);
  } else {
    path.LineTo(PointT<float>{left, top});
  }
  path.Close();
}

}  // namespace

float GetFontBaseline(const pictel::FontP& font, const RectT<float>& rect) {
  const pictel::FontInterface& face = *font;
  const float ascent = face.GetAscent();
  const float descent = face.GetDescent();
  return std::round(rect.top + ascent + (rect.height - (ascent + descent)) * 0.5f);
}

void GetEllipsePath(const pictel::SupplierInterface* supplier, const RectT<float>& rect,
                    PathP* path) {
  velkcore::RequireInput(supplier != nullptr && path != nullptr);
  *path = PathP(*supplier);
  if (HasArea(rect)) AddEllipse(**path, rect);
}

void GetRoundedRectPath(const pictel::SupplierInterface* supplier, const RectT<float>& rect,
                        float radius, PathP* path) {
  velkcore::RequireInput(supplier != nullptr && path != nullptr);
  *path = PathP(*supplier);
  if (HasArea(rect)) AddRoundedRect(**path, rect, radius, {true, true, true, true});
}

}  // namespace velkui

namespace velkui::utils {

void FormRect(pictel::PathP& path, const RectT<float>& rect) {
  (*path).AddRect(rect);
}

void FormRoundedRect(pictel::PathP& path, const RectT<float>& rect, float radius) {
  FormRoundedRect(path, rect, radius, {true, true, true, true});
}

void FormRoundedRect(pictel::PathP& path, const RectT<float>& rect, float radius,
                     const RoundedCorners& corners) {
  pictel::PathInterface& target = *path;
  if (HasArea(rect)) AddRoundedRect(target, rect, radius, corners);
}

}  // namespace velkui::utils
