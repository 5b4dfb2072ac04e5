#include <velkui/test/RecordingSupplier.h>

#include <algorithm>
#include <charconv>
#include <cmath>
#include <cstring>

#include <velkcore/Error.h>
#include <velkui/pictel/PictelErrors.h>
#include <velkui/test/FixedMetricsFont.h>

namespace velkui::test {

using namespace velkui::pictel;
using velkcore::MatrixT;
using velkcore::PointT;
using velkcore::RectT;

std::string Spell(float value) {
  char buffer[32];
  const auto result = std::to_chars(buffer, buffer + sizeof buffer, value);
  return std::string(buffer, result.ptr);
}

std::string Spell(const ColorRGBA& color) {
  return "(" + Spell(color.red) + "," + Spell(color.green) + "," + Spell(color.blue) + "," +
         Spell(color.alpha) + ")";
}

std::string Spell(const RectT<float>& rect) {
  return "[" + Spell(rect.left) + "," + Spell(rect.top) + "," + Spell(rect.width) + "," +
         Spell(rect.height) + "]";
}

std::string Spell(const PointT<float>& point) {
  return Spell(point.x) + "," + Spell(point.y);
}

namespace {

std::string DescribeStops(const ColorRGBA* colors, const float* positions, std::int32_t count) {
  std::string stops;
  for (std::int32_t i = 0; i < count; ++i) {
    stops += " " + Spell(positions[i]) + ":" + Spell(colors[i]);
  }
  return stops;
}

const std::string& DescribeBrush(const BrushInterface& brush) {
  return velkcore::CheckedCast<const RecordingBrush>(&brush)->Describe();
}

const RecordingPath& AsRecordingPath(const PathInterface& path) {
  return *velkcore::CheckedCast<const RecordingPath>(&path);
}

RectT<std::int32_t> DeviceBounds(const RectT<float>& rect, const MatrixT<float>& matrix) {
  const PointT<float> corners[4] = {matrix.Transform({rect.left, rect.top}),
                                    matrix.Transform({rect.Right(), rect.top}),
                                    matrix.Transform({rect.left, rect.Bottom()}),
                                    matrix.Transform({rect.Right(), rect.Bottom()})};
  float left = corners[0].x, right = corners[0].x, top = corners[0].y, bottom = corners[0].y;
  for (const auto& c : corners) {
    left = std::min(left, c.x);
    right = std::max(right, c.x);
    top = std::min(top, c.y);
    bottom = std::max(bottom, c.y);
  }
  const auto l = static_cast<std::int32_t>(std::floor(left));
  const auto t = static_cast<std::int32_t>(std::floor(top));
  return {l, t, static_cast<std::int32_t>(std::ceil(right)) - l,
          static_cast<std::int32_t>(std::ceil(bottom)) - t};
}

std::string UTF8(const char16_t* text) {
  return velkcore::UTF16to8(text);
}

// Runs a buffer's deleter when the last user of the pixels goes.
std::shared_ptr<void> PixelOwner(void* pixels, BufferDeleter deleter) {
  return std::shared_ptr<void>(pixels, [deleter = std::move(deleter)](void* p) {
    if (deleter) deleter(p);
  });
}

}  // namespace

std::string RecordedCall::ToString() const {
  return arguments.empty() ? name : name + " " + arguments;
}

std::vector<std::string> CallLog::Strings(int surface, bool drawingOnly) const {
  static const std::vector<std::string> bookkeeping = {
      "PushStateStack",         "PopStateStack",        "Transform", "Clip", "SetAntiAliasPolicy",
      "SetInterpolationPolicy", "SetTextDisplayPolicy", "Flush"};
  std::vector<std::string> out;
  for (const auto& call : calls_) {
    if (surface != 0 && call.surface != surface) continue;
    if (drawingOnly &&
        std::find(bookkeeping.begin(), bookkeeping.end(), call.name) != bookkeeping.end()) {
      continue;
    }
    out.push_back(call.ToString());
  }
  return out;
}

std::vector<std::string> CallLog::Names(int surface) const {
  std::vector<std::string> out;
  for (const auto& call : calls_) {
    if (surface == 0 || call.surface == surface) out.push_back(call.name);
  }
  return out;
}

// --- RecordingPath ---

void RecordingPath::Include(float x, float y) {
  if (empty_) {
    minX_ = maxX_ = x;
    minY_ = maxY_ = y;
    empty_ = false;
    return;
  }
  minX_ = std::min(minX_, x);
  maxX_ = std::max(maxX_, x);
  minY_ = std::min(minY_, y);
  maxY_ = std::max(maxY_, y);
}

void RecordingPath::MoveTo(const PointT<float>& point) {
  ClearWholeNumbered();
  segments_.push_back("M" + Spell(point));
  Include(point.x, point.y);
}

void RecordingPath::LineTo(const PointT<float>& point) {
  ClearWholeNumbered();
  segments_.push_back("L" + Spell(point));
  Include(point.x, point.y);
}

void RecordingPath::BezierTo(const PointT<float>& c1, const PointT<float>& c2,
                             const PointT<float>& end) {
  ClearWholeNumbered();
  segments_.push_back("C" + Spell(c1) + " " + Spell(c2) + " " + Spell(end));
  Include(c1.x, c1.y);
  Include(c2.x, c2.y);
  Include(end.x, end.y);
}

void RecordingPath::AddRect(const RectT<float>& rect) {
  ClearWholeNumbered();
  const std::string spelled = Spell(rect);
  segments_.push_back("R" + spelled.substr(1, spelled.size() - 2));
  Include(rect.left, rect.top);
  Include(rect.Right(), rect.Bottom());
}

void RecordingPath::AddArc(const PointT<float>& centre, float radius, float startAngle,
                           float sweepAngle) {
  ClearWholeNumbered();
  segments_.push_back("A" + Spell(centre) + " " + Spell(radius) + " " + Spell(startAngle) + " " +
                      Spell(sweepAngle));
  Include(centre.x - radius, centre.y - radius);
  Include(centre.x + radius, centre.y + radius);
}

void RecordingPath::Close() {
  segments_.push_back("Z");
}

std::string RecordingPath::Describe() const {
  std::string text = IsWholeNumbered() ? "W" : "";
  for (const auto& segment : segments_) {
    if (!text.empty()) text += " ";
    text += segment;
  }
  return text;
}

RectT<float> RecordingPath::GetBounds() const {
  if (empty_) return {};
  return {minX_, minY_, maxX_ - minX_, maxY_ - minY_};
}

// --- RecordingPen ---

void RecordingPen::SetLineJoin(LineJoinType join) {
  ValidateLineJoinType(join);
  join_ = join;
}

void RecordingPen::SetLineCap(LineCapType cap) {
  ValidateLineCapType(cap);
  cap_ = cap;
}

void RecordingPen::SetDashArray(const float* dashes, std::int32_t count) {
  velkcore::RequireInput(count >= 0 && (count == 0 || dashes != nullptr));
  dashes_.assign(dashes, dashes + count);
}

void RecordingPen::GetDashArray(float* dashes, std::int32_t count) const {
  const auto n =
      std::min<std::size_t>(static_cast<std::size_t>(std::max(0, count)), dashes_.size());
  std::copy_n(dashes_.begin(), n, dashes);
}

std::string RecordingPen::Describe() const {
  return "pen" + Spell(color_) + " w" + Spell(width_);
}

// --- RecordingImage ---

RecordingImage::RecordingImage(std::int32_t width, std::int32_t height, std::string name)
    : width_(width), height_(height), name_(std::move(name)) {}

// --- RecordingSupplier ---

RecordingSupplier::RecordingSupplier() : log_(std::make_shared<CallLog>()) {}

boost::intrusive_ptr<SurfaceInterface> RecordingSupplier::NewOSSurface(OSDeviceContext,
                                                                       const OSClipRegion*,
                                                                       bool) const {
  return NewSurface(640, 480, true);
}

boost::intrusive_ptr<SurfaceInterface> RecordingSupplier::NewImageSurface(
    ImageInterface* image, bool, const RectT<std::int32_t>*) const {
  velkcore::RequireInput(image != nullptr);
  return NewSurface(image->GetWidth(), image->GetHeight(), true);
}

boost::intrusive_ptr<SurfaceInterface> RecordingSupplier::NewSurface(std::int32_t width,
                                                                     std::int32_t height,
                                                                     bool) const {
  return new RecordingSurface(this, log_, nextSurfaceId_++, width, height, surfacesHaveImages_);
}

boost::intrusive_ptr<SurfaceInterface> RecordingSupplier::NewBufferSurface(
    std::int32_t width, std::int32_t height, std::int32_t, PixelLayout, void* pixels,
    BufferDeleter deleter) const {
  auto surface = boost::intrusive_ptr<RecordingSurface>(
      new RecordingSurface(this, log_, nextSurfaceId_++, width, height, surfacesHaveImages_));
  surface->SetPixelOwner(PixelOwner(pixels, std::move(deleter)));
  return surface;
}

boost::intrusive_ptr<PenInterface> RecordingSupplier::NewPen(const ColorRGBA& color,
                                                             float width) const {
  return new RecordingPen(color, width);
}

boost::intrusive_ptr<BrushInterface> RecordingSupplier::NewBrush(const ColorRGBA& color) const {
  return new RecordingBrush("solid" + Spell(color));
}

boost::intrusive_ptr<LinearShaderInterface> RecordingSupplier::CreateLinearShader(
    const PointT<float>& start, const PointT<float>& end, const ColorRGBA* colors,
    const float* positions, std::int32_t count) const {
  velkcore::RequireInput(colors != nullptr && positions != nullptr && count > 0);
  return new RecordingLinearShader("linear " + Spell(start) + "->" + Spell(end) +
                                   DescribeStops(colors, positions, count));
}

boost::intrusive_ptr<RadialShaderInterface> RecordingSupplier::CreateRadialShader(
    const PointT<float>& centre, float radius, const ColorRGBA* colors, const float* positions,
    std::int32_t count) const {
  velkcore::RequireInput(colors != nullptr && positions != nullptr && count > 0);
  return new RecordingRadialShader("radial " + Spell(centre) + " r" + Spell(radius) +
                                   DescribeStops(colors, positions, count));
}

boost::intrusive_ptr<FontInterface> RecordingSupplier::NewFont(const velkcore::UTF16String& family,
                                                               const velkcore::UTF16String& style,
                                                               float size) const {
  return new FixedMetricsFont(family, style, size);
}

boost::intrusive_ptr<ImageInterface> RecordingSupplier::NewFileImage(const void* bytes,
                                                                     std::size_t size,
                                                                     ImageFileType) const {
  // PNG: 8-byte signature, then the IHDR chunk with big-endian width and height.
  static constexpr unsigned char kSignature[8] = {0x89, 'P', 'N', 'G', '\r', '\n', 0x1A, '\n'};
  const auto* data = static_cast<const unsigned char*>(bytes);
  if (data == nullptr || size < 24 || std::memcmp(data, kSignature, 8) != 0) {
    ThrowPictelError(kErrorUnableToReadImageFileKey, kErrorUnableToReadImageFile);
  }
  const auto readBigEndian = [data](std::size_t at) {
    return static_cast<std::int32_t>((std::uint32_t{data[at]} << 24) |
                                     (std::uint32_t{data[at + 1]} << 16) |
                                     (std::uint32_t{data[at + 2]} << 8) | data[at + 3]);
  };
  return new RecordingImage(readBigEndian(16), readBigEndian(20), "file");
}

boost::intrusive_ptr<ImageInterface> RecordingSupplier::NewBufferImage(
    std::int32_t width, std::int32_t height, std::int32_t, PixelLayout, void* pixels,
    BufferDeleter deleter) const {
  auto image = boost::intrusive_ptr<RecordingImage>(new RecordingImage(width, height, "buffer"));
  image->SetPixelOwner(PixelOwner(pixels, std::move(deleter)));
  return image;
}

boost::intrusive_ptr<PathInterface> RecordingSupplier::NewPath() const {
  return new RecordingPath();
}

// --- RecordingSurface ---

RecordingSurface::RecordingSurface(const RecordingSupplier* supplier, std::shared_ptr<CallLog> log,
                                   int id, std::int32_t width, std::int32_t height, bool hasImage)
    : SurfaceInterface(supplier),
      log_(std::move(log)),
      id_(id),
      width_(width),
      height_(height),
      hasImage_(hasImage) {
  State bottom;
  bottom.clip = {0, 0, width, height};
  states_.push_back(bottom);
}

void RecordingSurface::Log(std::string name, std::string arguments) {
  const State& state = states_.back();
  log_->Add(RecordedCall{id_, std::move(name), std::move(arguments), state.matrix, state.clip,
                         state.antiAlias, state.interpolation});
}

void RecordingSurface::PushStateStack() {
  Log("PushStateStack", "");
  states_.push_back(states_.back());
}

void RecordingSurface::PopStateStack() {
  Log("PopStateStack", "");
  if (states_.size() > 1) states_.pop_back();
}

void RecordingSurface::PaintRect(const ColorRGBA& color, const RectT<float>& rect) {
  if (!(rect.width > 0.0f) || !(rect.height > 0.0f)) return;
  Log("PaintRect", Spell(color) + " " + Spell(rect));
}

void RecordingSurface::FillPath(const BrushInterface& brush, const PathInterface& path,
                                FillType fillType) {
  ValidateFillType(fillType);
  Log("FillPath", DescribeBrush(brush) + " " + AsRecordingPath(path).Describe() + " rule" +
                      std::to_string(static_cast<int>(fillType)));
}

void RecordingSurface::StrokePath(const PenInterface& pen, const PathInterface& path) {
  if (!(pen.GetWidth() > 0.0f)) return;
  Log("StrokePath", velkcore::CheckedCast<const RecordingPen>(&pen)->Describe() + " " +
                        AsRecordingPath(path).Describe());
}

void RecordingSurface::ShadePath(const ShaderInterface& shader, const PathInterface& path,
                                 FillType fillType) {
  ValidateFillType(fillType);
  Log("ShadePath", velkcore::CheckedCast<const RecordingBrush>(&shader)->Describe() + " " +
                       AsRecordingPath(path).Describe() + " rule" +
                       std::to_string(static_cast<int>(fillType)));
}

void RecordingSurface::Clip(const PathInterface& path, FillType fillType) {
  ValidateFillType(fillType);
  const RecordingPath& recording = AsRecordingPath(path);
  Log("Clip", recording.Describe());
  State& state = states_.back();
  state.clip =
      velkcore::Intersection(state.clip, DeviceBounds(recording.GetBounds(), state.matrix));
}

RectT<std::int32_t> RecordingSurface::GetClipBounds() const {
  const State& state = states_.back();
  if (state.clip.IsEmpty()) return {};
  const MatrixT<float> inverse = state.matrix.Inverted();
  const RectT<float> device{static_cast<float>(state.clip.left), static_cast<float>(state.clip.top),
                            static_cast<float>(state.clip.width),
                            static_cast<float>(state.clip.height)};
  return DeviceBounds(device, inverse);
}

void RecordingSurface::Transform(const MatrixT<float>& matrix) {
  Log("Transform", Spell(matrix.a) + "," + Spell(matrix.b) + "," + Spell(matrix.c) + "," +
                       Spell(matrix.d) + "," + Spell(matrix.tx) + "," + Spell(matrix.ty));
  states_.back().matrix = states_.back().matrix.Concat(matrix);
}

void RecordingSurface::GetTransform(MatrixT<float>* matrix) const {
  *matrix = states_.back().matrix;
}

float RecordingSurface::MeasureStringWidth(const FontInterface& font, const char16_t* text,
                                           std::int32_t length) const {
  return font.MeasureStringWidth(text, length);
}

float RecordingSurface::MeasureMultiLineStringHeight(const FontInterface& font,
                                                     const char16_t* text, float width,
                                                     std::int32_t length) const {
  return font.MeasureMultiLineStringHeight(text, length, width);
}

void RecordingSurface::DrawImage(const ImageInterface& image, const PointT<float>& topLeft,
                                 float opacity) {
  const auto* recorded = dynamic_cast<const RecordingImage*>(&image);
  const std::string name = recorded != nullptr ? recorded->GetName() : "image";
  Log("DrawImage", name + " " + std::to_string(image.GetWidth()) + "x" +
                       std::to_string(image.GetHeight()) + " at " + Spell(topLeft) + " opacity " +
                       Spell(opacity));
}

boost::intrusive_ptr<ImageInterface> RecordingSurface::GetSurfaceImage() {
  if (!hasImage_) return nullptr;
  return new RecordingImage(width_, height_, "surface#" + std::to_string(id_));
}

void RecordingSurface::SetInterpolationPolicy(InterpolationPolicy policy) {
  ValidateInterpolationPolicy(policy);
  Log("SetInterpolationPolicy", std::to_string(static_cast<int>(policy)));
  states_.back().interpolation = policy;
}

InterpolationPolicy RecordingSurface::GetInterpolationPolicy() const {
  return states_.back().interpolation;
}

void RecordingSurface::SetAntiAliasPolicy(AntiAliasPolicy policy) {
  ValidateAntiAliasPolicy(policy);
  Log("SetAntiAliasPolicy", std::to_string(static_cast<int>(policy)));
  states_.back().antiAlias = policy;
}

AntiAliasPolicy RecordingSurface::GetAntiAliasPolicy() const {
  return states_.back().antiAlias;
}

void RecordingSurface::SetTextDisplayPolicy(TextDisplayPolicy policy) {
  Log("SetTextDisplayPolicy", std::to_string(static_cast<int>(policy)));
  states_.back().textDisplay = policy;
}

TextDisplayPolicy RecordingSurface::GetTextDisplayPolicy() const {
  return states_.back().textDisplay;
}

void RecordingSurface::Flush() {
  Log("Flush", "");
}

void RecordingSurface::DrawStringImpl(const BrushInterface& brush, const FontInterface&,
                                      const char16_t* text, const PointT<float>& point,
                                      TextAlignment alignment) {
  Log("DrawString", "\"" + UTF8(text) + "\" at " + Spell(point) + " align" +
                        std::to_string(static_cast<int>(alignment)) + " " + DescribeBrush(brush));
}

void RecordingSurface::DrawMultiLineStringImpl(const BrushInterface& brush, const FontInterface&,
                                               const char16_t* text, const RectT<float>& rect,
                                               TextAlignment alignment) {
  Log("DrawMultiLineString", "\"" + UTF8(text) + "\" in " + Spell(rect) + " align" +
                                 std::to_string(static_cast<int>(alignment)) + " " +
                                 DescribeBrush(brush));
}

}  // namespace velkui::test
