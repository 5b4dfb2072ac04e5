#pragma once

#include <cstdint>
#include <memory>
#include <string>
#include <vector>

#include <velkcore/Geometry.h>
#include <velkui/pictel/BrushInterface.h>
#include <velkui/pictel/ImageInterface.h>
#include <velkui/pictel/PathInterface.h>
#include <velkui/pictel/PenInterface.h>
#include <velkui/pictel/SupplierInterface.h>
#include <velkui/pictel/SurfaceInterface.h>

namespace velkui::test {

// One call a recording surface received, with the state it was made in.
struct RecordedCall {
  int surface = 0;        // id of the surface (RecordingSurface::GetId)
  std::string name;       // "PaintRect", "FillPath", "DrawString", ...
  std::string arguments;  // the arguments, spelled out
  velkcore::MatrixT<float> transform;
  velkcore::RectT<std::int32_t> clip;  // device pixels
  pictel::AntiAliasPolicy antiAlias = pictel::AntiAliasPolicy::kOn;
  pictel::InterpolationPolicy interpolation = pictel::InterpolationPolicy::kHighQuality;

  // "name arguments".
  std::string ToString() const;
};

// Every call of every surface of one supplier, in order.
class CallLog {
 public:
  void Add(RecordedCall call) { calls_.push_back(std::move(call)); }
  const std::vector<RecordedCall>& GetCalls() const { return calls_; }
  // The calls as "name arguments" strings, optionally only those of one surface
  // and only drawing calls (no Push/Pop/Transform/Clip/policy bookkeeping).
  std::vector<std::string> Strings(int surface = 0, bool drawingOnly = false) const;
  std::vector<std::string> Names(int surface = 0) const;
  void Clear() { calls_.clear(); }

 private:
  std::vector<RecordedCall> calls_;
};

// A path that remembers its segments: "M x,y", "L x,y", "C x,y x,y x,y",
// "A cx,cy r start sweep", "Z".
class RecordingPath : public pictel::PathInterface {
 public:
  using PathInterface::AddRect;
  using PathInterface::BezierTo;
  using PathInterface::LineTo;
  using PathInterface::MoveTo;

  void MoveTo(const velkcore::PointT<float>& point) override;
  void LineTo(const velkcore::PointT<float>& point) override;
  void BezierTo(const velkcore::PointT<float>& c1, const velkcore::PointT<float>& c2,
                const velkcore::PointT<float>& end) override;
  void AddRect(const velkcore::RectT<float>& rect) override;
  void AddArc(const velkcore::PointT<float>& centre, float radius, float startAngle,
              float sweepAngle) override;
  void Close() override;

  const std::vector<std::string>& GetSegments() const { return segments_; }
  // The segments joined by spaces, with "W" in front while the path is whole-numbered.
  std::string Describe() const;
  // Bounding box of every point (control points and arc extremes included).
  velkcore::RectT<float> GetBounds() const;

 private:
  void Include(float x, float y);

  std::vector<std::string> segments_;
  bool empty_ = true;
  float minX_ = 0, minY_ = 0, maxX_ = 0, maxY_ = 0;
};

class RecordingPen : public pictel::PenInterface {
 public:
  RecordingPen(const pictel::ColorRGBA& color, float width) : color_(color), width_(width) {}
  void SetWidth(float width) override { width_ = width; }
  float GetWidth() const override { return width_; }
  void SetMiterLimit(float limit) override { miterLimit_ = limit; }
  float GetMiterLimit() const override { return miterLimit_; }
  void SetLineJoin(pictel::LineJoinType join) override;
  pictel::LineJoinType GetLineJoin() const override { return join_; }
  void SetLineCap(pictel::LineCapType cap) override;
  pictel::LineCapType GetLineCap() const override { return cap_; }
  void SetDashArray(const float* dashes, std::int32_t count) override;
  void GetDashArray(float* dashes, std::int32_t count) const override;
  std::int32_t GetDashCount() const override { return static_cast<std::int32_t>(dashes_.size()); }
  std::string Describe() const;

 private:
  pictel::ColorRGBA color_;
  float width_;
  float miterLimit_ = 10.0f;
  pictel::LineJoinType join_ = pictel::LineJoinType::kMiter;
  pictel::LineCapType cap_ = pictel::LineCapType::kFlat;
  std::vector<float> dashes_;
};

// Brushes and gradients describe themselves for the log.
class RecordingBrush : public pictel::BrushInterface {
 public:
  explicit RecordingBrush(std::string description) : description_(std::move(description)) {}
  const std::string& Describe() const { return description_; }

 private:
  std::string description_;
};

class RecordingLinearShader : public pictel::LinearShaderInterface, public RecordingBrush {
 public:
  using RecordingBrush::RecordingBrush;
};

class RecordingRadialShader : public pictel::RadialShaderInterface, public RecordingBrush {
 public:
  using RecordingBrush::RecordingBrush;
};

class RecordingImage : public pictel::ImageInterface {
 public:
  RecordingImage(std::int32_t width, std::int32_t height, std::string name);
  std::int32_t GetWidth() const override { return width_; }
  std::int32_t GetHeight() const override { return height_; }
  const std::string& GetName() const { return name_; }
  // Keeps whatever owns the image's pixels alive as long as the image.
  void SetPixelOwner(std::shared_ptr<void> owner) { pixelOwner_ = std::move(owner); }

 private:
  std::shared_ptr<void> pixelOwner_;
  std::int32_t width_;
  std::int32_t height_;
  std::string name_;
};

// A supplier whose surfaces draw nothing and log every call.
class RecordingSupplier : public pictel::SupplierInterface {
 public:
  RecordingSupplier();

  boost::intrusive_ptr<pictel::SurfaceInterface> NewOSSurface(pictel::OSDeviceContext context,
                                                              const pictel::OSClipRegion* region,
                                                              bool buffered) const override;
  boost::intrusive_ptr<pictel::SurfaceInterface> NewImageSurface(
      pictel::ImageInterface* image, bool clear,
      const velkcore::RectT<std::int32_t>* bounds) const override;
  boost::intrusive_ptr<pictel::SurfaceInterface> NewSurface(std::int32_t width, std::int32_t height,
                                                            bool transparent) const override;
  boost::intrusive_ptr<pictel::SurfaceInterface> NewBufferSurface(
      std::int32_t width, std::int32_t height, std::int32_t rowBytes, pictel::PixelLayout layout,
      void* pixels, pictel::BufferDeleter deleter) const override;
  boost::intrusive_ptr<pictel::PenInterface> NewPen(const pictel::ColorRGBA& color,
                                                    float width) const override;
  boost::intrusive_ptr<pictel::BrushInterface> NewBrush(
      const pictel::ColorRGBA& color) const override;
  bool SupportsLinearShaders() const override { return GetShadersEnabled(); }
  boost::intrusive_ptr<pictel::LinearShaderInterface> CreateLinearShader(
      const velkcore::PointT<float>& start, const velkcore::PointT<float>& end,
      const pictel::ColorRGBA* colors, const float* positions, std::int32_t count) const override;
  bool SupportsRadialShaders() const override { return GetShadersEnabled(); }
  boost::intrusive_ptr<pictel::RadialShaderInterface> CreateRadialShader(
      const velkcore::PointT<float>& centre, float radius, const pictel::ColorRGBA* colors,
      const float* positions, std::int32_t count) const override;
  bool SupportsAntiAliasing() const override { return true; }
  // A FixedMetricsFont (advance ratio 0.5) of any family.
  boost::intrusive_ptr<pictel::FontInterface> NewFont(const velkcore::UTF16String& family,
                                                      const velkcore::UTF16String& style,
                                                      float size) const override;
  // Reads the size from a PNG header (error 28 for anything else).
  boost::intrusive_ptr<pictel::ImageInterface> NewFileImage(
      const void* bytes, std::size_t size, pictel::ImageFileType type) const override;
  boost::intrusive_ptr<pictel::ImageInterface> NewBufferImage(
      std::int32_t width, std::int32_t height, std::int32_t rowBytes, pictel::PixelLayout layout,
      void* pixels, pictel::BufferDeleter deleter) const override;
  boost::intrusive_ptr<pictel::PathInterface> NewPath() const override;
  bool PrefersToCacheAggressively() const override { return prefersCaching_; }

  void SetPrefersToCacheAggressively(bool prefers) { prefersCaching_ = prefers; }
  CallLog& GetLog() const { return *log_; }
  // Surfaces made from now on have no image (GetSurfaceImage returns null).
  void SetSurfacesHaveImages(bool have) { surfacesHaveImages_ = have; }

 private:
  std::shared_ptr<CallLog> log_;
  mutable int nextSurfaceId_ = 1;
  bool prefersCaching_ = false;
  bool surfacesHaveImages_ = true;
};

// A surface of a given pixel size that logs what it is asked to draw. It keeps
// the matrix, a rectangular clip (the device bounding box of clip paths) and
// the policies with a real state stack.
class RecordingSurface : public pictel::SurfaceInterface {
 public:
  using SurfaceInterface::DrawImage;

  RecordingSurface(const RecordingSupplier* supplier, std::shared_ptr<CallLog> log, int id,
                   std::int32_t width, std::int32_t height, bool hasImage);

  int GetId() const { return id_; }
  std::size_t GetStateDepth() const { return states_.size() - 1; }
  // Keeps whatever owns the surface's pixels alive as long as the surface.
  void SetPixelOwner(std::shared_ptr<void> owner) { pixelOwner_ = std::move(owner); }

  void PushStateStack() override;
  void PopStateStack() override;
  void PaintRect(const pictel::ColorRGBA& color, const velkcore::RectT<float>& rect) override;
  void FillPath(const pictel::BrushInterface& brush, const pictel::PathInterface& path,
                pictel::FillType fillType) override;
  void StrokePath(const pictel::PenInterface& pen, const pictel::PathInterface& path) override;
  void ShadePath(const pictel::ShaderInterface& shader, const pictel::PathInterface& path,
                 pictel::FillType fillType) override;
  void Clip(const pictel::PathInterface& path, pictel::FillType fillType) override;
  velkcore::RectT<std::int32_t> GetClipBounds() const override;
  void Transform(const velkcore::MatrixT<float>& matrix) override;
  void GetTransform(velkcore::MatrixT<float>* matrix) const override;
  float MeasureStringWidth(const pictel::FontInterface& font, const char16_t* text,
                           std::int32_t length) const override;
  float MeasureMultiLineStringHeight(const pictel::FontInterface& font, const char16_t* text,
                                     float width, std::int32_t length) const override;
  void DrawImage(const pictel::ImageInterface& image, const velkcore::PointT<float>& topLeft,
                 float opacity) override;
  boost::intrusive_ptr<pictel::ImageInterface> GetSurfaceImage() override;
  void SetInterpolationPolicy(pictel::InterpolationPolicy policy) override;
  pictel::InterpolationPolicy GetInterpolationPolicy() const override;
  void SetAntiAliasPolicy(pictel::AntiAliasPolicy policy) override;
  pictel::AntiAliasPolicy GetAntiAliasPolicy() const override;
  void SetTextDisplayPolicy(pictel::TextDisplayPolicy policy) override;
  pictel::TextDisplayPolicy GetTextDisplayPolicy() const override;
  void Flush() override;

 protected:
  void DrawStringImpl(const pictel::BrushInterface& brush, const pictel::FontInterface& font,
                      const char16_t* text, const velkcore::PointT<float>& point,
                      pictel::TextAlignment alignment) override;
  void DrawMultiLineStringImpl(const pictel::BrushInterface& brush,
                               const pictel::FontInterface& font, const char16_t* text,
                               const velkcore::RectT<float>& rect,
                               pictel::TextAlignment alignment) override;

 private:
  struct State {
    velkcore::MatrixT<float> matrix;
    velkcore::RectT<std::int32_t> clip;
    pictel::AntiAliasPolicy antiAlias = pictel::AntiAliasPolicy::kOn;
    pictel::InterpolationPolicy interpolation = pictel::InterpolationPolicy::kHighQuality;
    pictel::TextDisplayPolicy textDisplay = pictel::TextDisplayPolicy::kAntiAliased;
  };

  void Log(std::string name, std::string arguments);

  std::shared_ptr<CallLog> log_;
  std::shared_ptr<void> pixelOwner_;
  int id_;
  std::int32_t width_;
  std::int32_t height_;
  bool hasImage_;
  std::vector<State> states_;
};

// Spelling helpers shared by the log and the tests.
std::string Spell(const pictel::ColorRGBA& color);
std::string Spell(const velkcore::RectT<float>& rect);
std::string Spell(const velkcore::PointT<float>& point);
std::string Spell(float value);

}  // namespace velkui::test
