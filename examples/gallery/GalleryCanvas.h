#pragma once

#include <string>

#include <boost/intrusive_ptr.hpp>

#include <velkui/pictel/Pictel.h>
#include <velkui/pictel/PictelHandles.h>

namespace gallery {

using velkcore::PointT;
using velkcore::RectT;
using velkui::pictel::ColorRGBA;

// The page the gallery draws on: a supplier, an offscreen surface, the fonts
// and a few drawing conveniences shared by the sections.
class GalleryCanvas {
 public:
  GalleryCanvas(std::int32_t width, std::int32_t height);

  const velkui::pictel::SupplierInterface& Supplier() const { return *supplier_; }
  velkui::pictel::SurfaceInterface& Surface() const { return *surface_; }
  velkui::pictel::Pictel& GetPictel() { return pictel_; }
  const velkui::pictel::FontP& TitleFont() const { return titleFont_; }
  const velkui::pictel::FontP& LabelFont() const { return labelFont_; }
  const velkui::pictel::FontP& BodyFont() const { return bodyFont_; }
  const velkui::pictel::FontP& BoldFont() const { return boldFont_; }
  const velkui::pictel::FontP& ItalicFont() const { return italicFont_; }

  // A card with a soft shadow and a title; returns the area inside it.
  RectT<float> Card(const RectT<float>& frame, const char16_t* title);
  void Label(const char16_t* text, const PointT<float>& at,
             velkui::pictel::TextAlignment alignment = velkui::pictel::TextAlignment::kStart,
             const ColorRGBA& color = kLabelColor);
  void Fill(const velkui::pictel::PathP& path, const ColorRGBA& color,
            velkui::pictel::FillType rule = velkui::pictel::FillType::kWinding);
  void Stroke(const velkui::pictel::PathP& path, const velkui::pictel::PenP& pen);
  velkui::pictel::PathP NewPath() const { return velkui::pictel::PathP(*supplier_); }
  velkui::pictel::PenP NewPen(const ColorRGBA& color, float width) const {
    return velkui::pictel::PenP(*supplier_, color, width);
  }
  // A thin dashed guide line.
  void Guide(const PointT<float>& from, const PointT<float>& to);

  void Save(const std::string& file) const;

  static constexpr ColorRGBA kInk{0.13f, 0.15f, 0.19f, 1};
  static constexpr ColorRGBA kLabelColor{0.40f, 0.44f, 0.50f, 1};
  static constexpr ColorRGBA kAccent{0.16f, 0.45f, 0.86f, 1};

 private:
  boost::intrusive_ptr<velkui::pictel::SupplierInterface> supplier_;
  velkui::pictel::SurfaceP surface_;
  velkui::pictel::Pictel pictel_;
  velkui::pictel::FontP titleFont_;
  velkui::pictel::FontP labelFont_;
  velkui::pictel::FontP bodyFont_;
  velkui::pictel::FontP boldFont_;
  velkui::pictel::FontP italicFont_;
};

}  // namespace gallery
