#pragma once

#include <cstdint>
#include <functional>
#include <utility>
#include <vector>

#include <boost/intrusive_ptr.hpp>

#include <velkcore/Geometry.h>
#include <velkcore/RefCountedObject.h>
#include <velkui/pictel/PictelTypes.h>

namespace velkui::pictel {

// Where converted colours go: a display, a pixel layout and a channel depth.
class ColorDestinationProfile {
 public:
  virtual ~ColorDestinationProfile() = default;

  void SetDisplayID(void* display) { displayID_ = display; }
  void* GetDisplayID() const { return displayID_; }
  void SetPixelLayout(PixelLayout layout) { layout_ = layout; }
  PixelLayout GetPixelLayout() const { return layout_; }
  // Bits per channel.
  void SetDepth(std::int32_t depth) { depth_ = depth; }
  std::int32_t GetDepth() const { return depth_; }
  // 3 for the three-byte layout (or a zero depth), else 4.
  std::int32_t GetBytesPerPixel() const;

 private:
  void* displayID_ = nullptr;
  PixelLayout layout_ = PixelLayout::kARGB;
  std::int32_t depth_ = 8;
};

// A profile for images: the whole image's pixel bounds and the part to convert.
class ImageDestinationProfile : public ColorDestinationProfile {
 public:
  void SetBounds(const velkcore::RectT<std::int32_t>& bounds) { bounds_ = bounds; }
  const velkcore::RectT<std::int32_t>& GetBounds() const { return bounds_; }
  void SetSubregion(const velkcore::RectT<std::int32_t>& subregion) { subregion_ = subregion; }
  const velkcore::RectT<std::int32_t>& GetSubregion() const { return subregion_; }

 private:
  velkcore::RectT<std::int32_t> bounds_;
  velkcore::RectT<std::int32_t> subregion_;
};

// The host derives from this to pass its own data to the colour-management callback.
class OpaqueApplicationData {
 public:
  virtual ~OpaqueApplicationData() = default;
};

using ColorManagementCallback = std::function<void(
    const ColorDestinationProfile& profile, const OpaqueApplicationData& data, void* destination)>;

// Stores the one process-wide colour-management callback (an empty one removes it).
void SetColorManagementCallback(ColorManagementCallback callback);

// Base of colours and images that may need colour management.
class AbstractVisual : public virtual velkcore::RefCountedObject {
 public:
  ~AbstractVisual() override = default;

  virtual bool IsManaged() const = 0;
  // Hands the work to the colour-management callback; error 36 when the visual
  // is not managed or no callback is stored.
  void Manage(const ColorDestinationProfile& profile, const OpaqueApplicationData& data,
              void* destination) const;
};

class AbstractColor : public AbstractVisual {
 public:
  virtual ColorRGBA Convert(const ColorDestinationProfile& profile) const = 0;
};

class UnManagedColor : public AbstractColor {
 public:
  bool IsManaged() const override { return false; }
};

class UnManagedRGBA : public UnManagedColor {
 public:
  explicit UnManagedRGBA(const ColorRGBA& color) : color_(color) {}
  ColorRGBA Convert(const ColorDestinationProfile&) const override { return color_; }
  const ColorRGBA& GetColor() const { return color_; }

 private:
  ColorRGBA color_;
};

class AbstractImage : public AbstractVisual {
 public:
  virtual std::int32_t GetWidth() const = 0;
  virtual std::int32_t GetHeight() const = 0;
};

// An image drawn as it is.
class UnManagedImage : public AbstractImage {
 public:
  explicit UnManagedImage(boost::intrusive_ptr<ImageInterface> image);
  ~UnManagedImage() override;
  bool IsManaged() const override { return false; }
  std::int32_t GetWidth() const override;
  std::int32_t GetHeight() const override;
  const boost::intrusive_ptr<ImageInterface>& GetImage() const { return image_; }

 private:
  boost::intrusive_ptr<ImageInterface> image_;
};

// An image whose pixels are produced for each destination display.
class ManagedImage : public AbstractImage {
 public:
  bool IsManaged() const override { return true; }
  // Writes the profile's subregion (image pixels) into `destination` in the
  // profile's layout: rows of subregion width × bytes per pixel, top to bottom.
  virtual void Convert(const ImageDestinationProfile& profile, void* destination) const = 0;
};

// A part of a rectangle that lies on one display, with that display's identity.
using MonitorPiece = std::pair<velkcore::RectT<std::int32_t>, void*>;
// The displays as (screen rectangle, identity) pairs.
using MonitorEnumerator = std::function<std::vector<MonitorPiece>()>;

// The window layer installs how displays are found; without one the whole
// plane is one display with a null identity.
void SetMonitorEnumerator(MonitorEnumerator enumerator);
// Each part of `rect` (screen pixels) that lies on one display.
std::vector<MonitorPiece> SubdivideByMonitor(const velkcore::RectT<std::int32_t>& rect);

// Paints `rect` (rounded outwards to whole units) display by display, with the
// colour converted for each; `screenOffset` is the surface origin on screen.
void PaintColorManagedRect(Pictel& pictel, const velkcore::RectT<float>& rect,
                           const velkcore::PointT<std::int32_t>& screenOffset,
                           const boost::intrusive_ptr<AbstractColor>& color);
// Draws the image scaled into `rect`, display by display.
void PaintColorManagedImage(Pictel& pictel, const velkcore::RectT<float>& rect,
                            const velkcore::PointT<std::int32_t>& screenOffset,
                            const boost::intrusive_ptr<AbstractImage>& image);

}  // namespace velkui::pictel
