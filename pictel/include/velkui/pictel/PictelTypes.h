#pragma once

#include <cstdint>
#include <functional>
#include <vector>

#include <velkcore/Geometry.h>

namespace velkui::pictel {

// Red, green, blue and alpha, each nominally 0..1.
struct ColorRGBA {
  float red{0};
  float green{0};
  float blue{0};
  float alpha{1};

  friend bool operator==(const ColorRGBA&, const ColorRGBA&) = default;
};

// The numeric values of every enumeration below are part of the interface:
// archives, controls and the backend pass them as numbers.

// Where the text's point is; the point's y is always the baseline.
enum class TextAlignment : std::int32_t {
  kStart = 0,
  kCenter = 1,
  kEnd = 2,
};

enum class TextTruncation : std::int32_t {
  kNone = 0,
  kEnd = 1,           // cut at the end
  kEndEllipsis = 2,   // cut at the end and append "..."
  kPathEllipsis = 3,  // keep head and tail, "..." in the middle
};

enum class FillType : std::int32_t {
  kEvenOdd = 0,
  kWinding = 1,
};

enum class LineCapType : std::int32_t {
  kFlat = 0,
  kRound = 1,
  kSquare = 2,
};

enum class LineJoinType : std::int32_t {
  kMiter = 0,
  kBevel = 1,
  kRound = 2,
};

enum class AntiAliasPolicy : std::int32_t {
  kOff = 0,
  kOn = 1,
  kHighQuality = 2,
};

enum class InterpolationPolicy : std::int32_t {
  kNearestNeighbor = 0,
  kLowQuality = 1,
  kHighQuality = 2,
};

// How glyph edges are smoothed; the backend combines it with the anti-alias policy.
enum class TextDisplayPolicy : std::int32_t {
  kAntiAliased = 0,
  kSubpixel = 1,
  kGridFitted = 2,
};

// Byte order of pixels in memory.
enum class PixelLayout : std::int32_t {
  kBGR = 1,                // 3 bytes: B, G, R
  kBGRX = 3,               // 4 bytes: B, G, R, unused
  kARGB = 4,               // A, R, G, B, straight alpha
  kARGBPremultiplied = 5,  // A, R, G, B, premultiplied alpha
  kBGRA = 6,               // B, G, R, A, straight alpha
  kBGRAPremultiplied = 7,  // B, G, R, A, premultiplied alpha
};

// Encoded image formats that file images are read from.
enum class ImageFileType : std::int32_t {
  kPNG = 0,
};

// A platform drawing target. With the Cairo backend this is a cairo_surface_t*
// (an image or an Xlib surface); the caller keeps it alive while a surface uses it.
using OSDeviceContext = void*;

// A clip region in device pixels: the union of its rectangles.
struct OSClipRegion {
  std::vector<velkcore::RectT<std::int32_t>> rects;
};

// Runs once when the last user of caller-owned pixels goes away; may be empty.
using BufferDeleter = std::function<void(void* pixels)>;

class SupplierInterface;
class SurfaceInterface;
class PathInterface;
class PenInterface;
class BrushInterface;
class ShaderInterface;
class LinearShaderInterface;
class RadialShaderInterface;
class FontInterface;
class ImageInterface;
class CacheInterface;
class BitmapCacheInterface;
class Pictel;

}  // namespace velkui::pictel
