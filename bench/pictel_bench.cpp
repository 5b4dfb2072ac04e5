// The same drawing through pictel and through direct Cairo (and Pango for
// text) calls, on 1920 × 1080 image surfaces. Compare the pairs of rows:
// Pictel/... against Cairo/... with the same arguments.
#include <cairo.h>
#include <pango/pangocairo.h>

#include <array>
#include <cmath>
#include <numbers>
#include <string>
#include <vector>

#include <benchmark/benchmark.h>

#include <velkui/pictel/OSSupplier.h>
#include <velkui/pictel/PathShapes.h>
#include <velkui/pictel/PictelHandles.h>

namespace {

using namespace velkui::pictel;
using velkcore::RectT;

constexpr int kWidth = 1920;
constexpr int kHeight = 1080;
constexpr int kRectCount = 1000;
constexpr int kLabelCount = 100;

const std::array<ColorRGBA, 4> kColors = {
    ColorRGBA{0.9f, 0.2f, 0.2f, 1}, ColorRGBA{0.2f, 0.7f, 0.3f, 0.8f},
    ColorRGBA{0.2f, 0.3f, 0.9f, 1}, ColorRGBA{0.5f, 0.5f, 0.5f, 0.6f}};

// Rectangles spread over the surface, the same for both sides; unaligned
// ones sit on fractional coordinates.
std::vector<RectT<float>> Rects(float size, bool aligned) {
  std::vector<RectT<float>> rects;
  rects.reserve(kRectCount);
  unsigned state = 12345;
  const auto next = [&state](int range) {
    state = state * 1103515245u + 12345u;
    return static_cast<float>((state >> 8) % static_cast<unsigned>(range));
  };
  const float offset = aligned ? 0.0f : 0.37f;
  for (int i = 0; i < kRectCount; ++i) {
    rects.push_back({next(kWidth - static_cast<int>(size)) + offset,
                     next(kHeight - static_cast<int>(size)) + offset, size, size});
  }
  return rects;
}

std::vector<std::string> Labels() {
  std::vector<std::string> labels;
  for (int i = 0; i < kLabelCount; ++i) {
    std::string label = "Track " + std::to_string(100 + i) + " - Final mix";
    label.resize(21, '.');
    labels.push_back(label);
  }
  return labels;
}

std::u16string ToUTF16(const std::string& ascii) {
  return std::u16string(ascii.begin(), ascii.end());
}

struct CairoTarget {
  CairoTarget()
      : surface(cairo_image_surface_create(CAIRO_FORMAT_ARGB32, kWidth, kHeight)),
        context(cairo_create(surface)) {}
  ~CairoTarget() {
    cairo_destroy(context);
    cairo_surface_destroy(surface);
  }
  CairoTarget(const CairoTarget&) = delete;
  CairoTarget& operator=(const CairoTarget&) = delete;

  cairo_surface_t* surface;
  cairo_t* context;
};

struct PictelTarget {
  boost::intrusive_ptr<SupplierInterface> supplier = NewOSSupplier();
  SurfaceP surface{*supplier, kWidth, kHeight, true};
};

void SetSource(cairo_t* context, const ColorRGBA& c) {
  cairo_set_source_rgba(context, c.red, c.green, c.blue, c.alpha);
}

// --- filled rectangles ---

void PictelFillRects(benchmark::State& state) {
  PictelTarget target;
  const auto rects = Rects(static_cast<float>(state.range(0)), state.range(1) != 0);
  for (auto _ : state) {
    for (int i = 0; i < kRectCount; ++i) target.surface->PaintRect(kColors[i % 4], rects[i]);
    target.surface->Flush();
  }
  state.SetItemsProcessed(state.iterations() * kRectCount);
}

void CairoFillRects(benchmark::State& state) {
  CairoTarget target;
  const auto rects = Rects(static_cast<float>(state.range(0)), state.range(1) != 0);
  for (auto _ : state) {
    for (int i = 0; i < kRectCount; ++i) {
      SetSource(target.context, kColors[i % 4]);
      cairo_rectangle(target.context, rects[i].left, rects[i].top, rects[i].width, rects[i].height);
      cairo_fill(target.context);
    }
    cairo_surface_flush(target.surface);
  }
  state.SetItemsProcessed(state.iterations() * kRectCount);
}

// --- stroked rounded rectangles ---

constexpr float kRoundedWidth = 48;
constexpr float kRoundedHeight = 24;
constexpr float kRadius = 6;

void PictelStrokeRoundedRects(benchmark::State& state) {
  PictelTarget target;
  const auto rects = Rects(kRoundedWidth, false);
  PenP pen(*target.supplier, {0.1f, 0.1f, 0.1f, 1}, 1.5f);
  for (auto _ : state) {
    for (const auto& r : rects) {
      PathP path;
      velkui::GetRoundedRectPath(target.supplier.get(),
                                 {r.left, r.top, kRoundedWidth, kRoundedHeight}, kRadius, &path);
      target.surface->StrokePath(*pen, *path);
    }
    target.surface->Flush();
  }
  state.SetItemsProcessed(state.iterations() * kRectCount);
}

void CairoStrokeRoundedRects(benchmark::State& state) {
  CairoTarget target;
  const auto rects = Rects(kRoundedWidth, false);
  constexpr double kDegrees = std::numbers::pi / 180.0;
  cairo_t* cr = target.context;
  for (auto _ : state) {
    for (const auto& r : rects) {
      const double left = r.left, top = r.top;
      const double right = left + kRoundedWidth, bottom = top + kRoundedHeight;
      cairo_new_sub_path(cr);
      cairo_arc(cr, right - kRadius, top + kRadius, kRadius, -90 * kDegrees, 0);
      cairo_arc(cr, right - kRadius, bottom - kRadius, kRadius, 0, 90 * kDegrees);
      cairo_arc(cr, left + kRadius, bottom - kRadius, kRadius, 90 * kDegrees, 180 * kDegrees);
      cairo_arc(cr, left + kRadius, top + kRadius, kRadius, 180 * kDegrees, 270 * kDegrees);
      cairo_close_path(cr);
      cairo_set_source_rgba(cr, 0.1, 0.1, 0.1, 1);
      cairo_set_line_width(cr, 1.5);
      cairo_stroke(cr);
    }
    cairo_surface_flush(target.surface);
  }
  state.SetItemsProcessed(state.iterations() * kRectCount);
}

// --- text labels ---

void PictelTextLabels(benchmark::State& state) {
  PictelTarget target;
  FontP font(*target.supplier, u"DejaVu Sans", u"", 13);
  BrushP ink(*target.supplier, {0, 0, 0, 1});
  std::vector<std::u16string> labels;
  for (const auto& label : Labels()) labels.push_back(ToUTF16(label));
  for (auto _ : state) {
    for (int i = 0; i < kLabelCount; ++i) {
      target.surface->DrawString(*ink, *font, labels[i].c_str(),
                                 {10.0f + (i % 10) * 180.0f, 30.0f + (i / 10) * 60.0f},
                                 TextAlignment::kStart, TextTruncation::kNone, 0);
    }
    target.surface->Flush();
  }
  state.SetItemsProcessed(state.iterations() * kLabelCount);
}

void CairoTextLabels(benchmark::State& state) {
  CairoTarget target;
  // The same text settings as the backend: one font map, grey anti-aliasing,
  // no hinting, unrounded positions.
  PangoFontMap* fontMap = pango_cairo_font_map_new();
  PangoContext* context = pango_font_map_create_context(fontMap);
  cairo_font_options_t* options = cairo_font_options_create();
  cairo_font_options_set_antialias(options, CAIRO_ANTIALIAS_GRAY);
  cairo_font_options_set_hint_style(options, CAIRO_HINT_STYLE_NONE);
  cairo_font_options_set_hint_metrics(options, CAIRO_HINT_METRICS_OFF);
  pango_cairo_context_set_font_options(context, options);
  pango_context_set_round_glyph_positions(context, FALSE);
  PangoLayout* layout = pango_layout_new(context);
  PangoFontDescription* description = pango_font_description_from_string("DejaVu Sans");
  pango_font_description_set_absolute_size(description, 13 * PANGO_SCALE);
  pango_layout_set_font_description(layout, description);
  const auto labels = Labels();
  cairo_t* cr = target.context;
  for (auto _ : state) {
    for (int i = 0; i < kLabelCount; ++i) {
      pango_layout_set_text(layout, labels[i].c_str(), static_cast<int>(labels[i].size()));
      const double baseline = pango_layout_get_baseline(layout) / double(PANGO_SCALE);
      cairo_set_source_rgba(cr, 0, 0, 0, 1);
      cairo_move_to(cr, 10.0 + (i % 10) * 180.0, 30.0 + (i / 10) * 60.0 - baseline);
      pango_cairo_show_layout(cr, layout);
      cairo_new_path(cr);
    }
    cairo_surface_flush(target.surface);
  }
  state.SetItemsProcessed(state.iterations() * kLabelCount);
  pango_font_description_free(description);
  g_object_unref(layout);
  cairo_font_options_destroy(options);
  g_object_unref(context);
  g_object_unref(fontMap);
}

// --- clearing the whole surface ---

void PictelClear(benchmark::State& state) {
  PictelTarget target;
  for (auto _ : state) {
    target.surface->PaintRect({1, 1, 1, 1}, {0, 0, kWidth, kHeight});
    target.surface->Flush();
  }
}

void CairoClear(benchmark::State& state) {
  CairoTarget target;
  for (auto _ : state) {
    cairo_set_source_rgba(target.context, 1, 1, 1, 1);
    cairo_paint(target.context);
    cairo_surface_flush(target.surface);
  }
}

void RectArguments(benchmark::internal::Benchmark* benchmark) {
  benchmark->ArgNames({"size", "aligned"});
  for (int size : {8, 32, 128, 256}) {
    for (int aligned : {1, 0}) benchmark->Args({size, aligned});
  }
}

}  // namespace

BENCHMARK(PictelFillRects)->Apply(RectArguments)->Unit(benchmark::kMicrosecond);
BENCHMARK(CairoFillRects)->Apply(RectArguments)->Unit(benchmark::kMicrosecond);
BENCHMARK(PictelStrokeRoundedRects)->Unit(benchmark::kMicrosecond);
BENCHMARK(CairoStrokeRoundedRects)->Unit(benchmark::kMicrosecond);
BENCHMARK(PictelTextLabels)->Unit(benchmark::kMicrosecond);
BENCHMARK(CairoTextLabels)->Unit(benchmark::kMicrosecond);
BENCHMARK(PictelClear)->Unit(benchmark::kMicrosecond);
BENCHMARK(CairoClear)->Unit(benchmark::kMicrosecond);
