#include "ControlDrawing.h"

#include <algorithm>
#include <string>

#include <velkcore/Error.h>
#include <velkui/pictel/Gradients.h>
#include <velkui/pictel/PathShapes.h>
#include <velkui/pictel/SupplierInterface.h>
#include <velkui/pictel/SurfaceInterface.h>
#include <velkui/ui/Theme.h>
#include <velkui/ui/UI_NodeManager.h>
#include <velkui/utility/LibraryResources.h>

namespace velkui::controls::detail {

namespace {

constexpr ui::ThemeFontIndex kControlFont = 7;
constexpr ui::ThemeColorIndex kWindowBackground = 4;
constexpr std::string_view kDarkSetPrefix = "KT7_";

float Luminance(const pictel::ColorRGBA& c) {
  return 0.2126f * c.red + 0.7152f * c.green + 0.0722f * c.blue;
}

}  // namespace

pictel::ColorRGBA ThemeColor(ui::UI_Color index, const ColorChangeMap* map) {
  return ui::Theme::Get().GetColor(UI_GetColorFromChangeMap(index, map));
}

pictel::ColorRGBA WithAlpha(pictel::ColorRGBA color, float alpha) {
  color.alpha *= alpha;
  return color;
}

pictel::ColorRGBA Mix(const pictel::ColorRGBA& a, const pictel::ColorRGBA& b, float t) {
  return {a.red + (b.red - a.red) * t, a.green + (b.green - a.green) * t,
          a.blue + (b.blue - a.blue) * t, a.alpha + (b.alpha - a.alpha) * t};
}

RectT<float> Inset(const RectT<float>& rect, float dx, float dy) {
  return {rect.left + dx, rect.top + dy, rect.width - 2 * dx, rect.height - 2 * dy};
}

bool IsDarkInterface() {
  if (!ui::Theme::IsInitialized() || !ui::Theme::Get().HasColor(kWindowBackground)) return false;
  return Luminance(ui::Theme::Get().GetColor(kWindowBackground)) < 0.45f;
}

pictel::PathP RoundedPath(const pictel::Pictel& context, const RectT<float>& rect, float radius,
                          bool topOnly) {
  pictel::PathP path(*context.GetSupplier());
  const float r = std::max(0.0f, std::min(radius, std::min(rect.width, rect.height) / 2));
  if (r <= 0) {
    path->AddRect(rect);
  } else if (topOnly) {
    utils::FormRoundedRect(path, rect, r, utils::RoundedCorners{true, true, false, false});
  } else {
    utils::FormRoundedRect(path, rect, r);
  }
  return path;
}

pictel::PathP EllipsePath(const pictel::Pictel& context, const RectT<float>& rect) {
  pictel::PathP path;
  GetEllipsePath(context.GetSupplier(), rect, &path);
  return path;
}

void Fill(pictel::Pictel& context, const pictel::PathP& path, const pictel::ColorRGBA& color) {
  const pictel::BrushP brush(*context.GetSupplier(), color);
  context.GetSurface()->FillPath(*brush, *path, pictel::FillType::kWinding);
}

void Stroke(pictel::Pictel& context, const pictel::PathP& path, const pictel::ColorRGBA& color,
            float width) {
  const pictel::PenP pen(*context.GetSupplier(), color, width);
  context.GetSurface()->StrokePath(*pen, *path);
}

void FillGradient(pictel::Pictel& context, pictel::PathP& path, const RectT<float>& rect,
                  const pictel::ColorRGBA& first, const pictel::ColorRGBA& last, float midpoint,
                  bool horizontal) {
  const PointT<float> start{rect.left, rect.top};
  const PointT<float> end = horizontal ? PointT<float>{rect.left + rect.width, rect.top}
                                       : PointT<float>{rect.left, rect.top + rect.height};
  const pictel::ColorRGBA colors[3] = {first, Mix(first, last, 0.5f), last};
  const float positions[3] = {0.0f, std::clamp(midpoint, 0.05f, 0.95f), 1.0f};
  utils::HandleGradient(&context, path, start, end, colors, positions, 3);
}

pictel::FontP ControlFont(const pictel::Pictel& context, float size, bool bold) {
  const ui::Theme& theme = ui::Theme::Get();
  return pictel::FontP(*context.GetSupplier(), theme.GetFontName(kControlFont),
                       bold ? u"Bold" : u"", size);
}

void DrawLabel(pictel::Pictel& context, const velkcore::UTF16String& text, const RectT<float>& rect,
               ControlAlignment alignment, const pictel::FontP& font,
               const pictel::ColorRGBA& color, std::size_t mnemonic) {
  if (text.empty() || rect.width <= 0) return;
  PointT<float> anchor{};
  const pictel::TextAlignment textAlignment = UI_GetPictelTextAlignment(alignment, rect, &anchor);
  anchor.y = GetFontBaseline(font, rect);
  const pictel::BrushP brush(*context.GetSupplier(), color);
  pictel::SurfaceInterface& surface = *context.GetSurface();
  if (mnemonic < text.size()) {
    const pictel::PenP pen(*context.GetSupplier(), color, 1.0f);
    const auto unit = static_cast<std::int32_t>(mnemonic);
    surface.DrawStringWithUnderline(*brush, *font, *pen, text.c_str(), anchor, textAlignment,
                                    pictel::TextTruncation::kEndEllipsis, rect.width, unit, unit);
  } else {
    surface.DrawString(*brush, *font, text.c_str(), anchor, textAlignment,
                       pictel::TextTruncation::kEndEllipsis, rect.width);
  }
}

float MeasureText(const pictel::Pictel& context, const pictel::FontP& font,
                  const velkcore::UTF16String& text) {
  if (text.empty()) return 0;
  return context.GetSurface() != nullptr
             ? context.GetSurface()->MeasureStringWidth(*font, text.c_str(), -1)
             : font->MeasureStringWidth(text.c_str(), -1);
}

bool HasControlImage(std::string_view name) {
  return utility::LibraryResources().Find(name, "png") != nullptr;
}

pictel::ImageP FindControlImage(const pictel::Pictel& context, std::string_view name) {
  std::string chosen(name);
  if (IsDarkInterface()) {
    const std::string dark = std::string(kDarkSetPrefix) + std::string(name);
    if (HasControlImage(dark)) chosen = dark;
  }
  if (!HasControlImage(chosen)) return {};
  const pictel::SupplierInterface& supplier = *context.GetSupplier();
  if (ui::UI_NodeManager* manager = ui::UI_NodeManager::Get(false)) {
    return pictel::ImageP(manager->GetPictelImageResourceCache().GetImage(
        utility::LibraryResources(), supplier, chosen, pictel::ImageFileType::kPNG));
  }
  const auto bytes = velkcore::GetBinaryFromModule(utility::LibraryResources(), chosen, "png");
  return pictel::ImageP(
      supplier.NewFileImage(bytes.data(), bytes.size(), pictel::ImageFileType::kPNG));
}

}  // namespace velkui::controls::detail

#include <velkui/controls/UI_TextControlBase.h>

namespace velkui::controls::detail {

pictel::FontP TextControlFont(const pictel::Pictel& context, const UI_TextControlBase& text) {
  const velkcore::UTF16String& family =
      text.GetFontName().empty() ? ui::Theme::Get().GetFontName(7) : text.GetFontName();
  return pictel::FontP(*context.GetSupplier(), family, text.GetFontStyleName(),
                       text.GetEffectiveFontSize());
}

}  // namespace velkui::controls::detail

#include <cmath>

namespace velkui::controls::detail {

void DrawImageIn(pictel::Pictel& context, const pictel::ImageInterface& image,
                 const velkcore::RectT<float>& destination, float opacity) {
  const velkcore::RectT<float> source{0, 0, static_cast<float>(image.GetWidth()),
                                      static_cast<float>(image.GetHeight())};
  context.GetSurface()->DrawImage(*context.GetSupplier(), image, destination, &source, opacity);
}

void RequireScale(const velkcore::PointT<float>& scale) {
  velkcore::RequireInput(std::isfinite(scale.x) && std::isfinite(scale.y) && scale.x > 0 &&
                         scale.y > 0);
}

}  // namespace velkui::controls::detail
