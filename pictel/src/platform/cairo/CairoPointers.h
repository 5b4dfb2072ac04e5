#pragma once

#include <memory>

#include <cairo.h>
#include <pango/pangocairo.h>

namespace velkui::pictel::cairo {

struct CairoSurfaceRelease {
  void operator()(cairo_surface_t* surface) const { cairo_surface_destroy(surface); }
};
struct CairoContextRelease {
  void operator()(cairo_t* context) const { cairo_destroy(context); }
};
struct CairoPatternRelease {
  void operator()(cairo_pattern_t* pattern) const { cairo_pattern_destroy(pattern); }
};
struct GObjectRelease {
  void operator()(gpointer object) const { g_object_unref(object); }
};
struct FontDescriptionRelease {
  void operator()(PangoFontDescription* description) const {
    pango_font_description_free(description);
  }
};

using CairoSurfacePtr = std::unique_ptr<cairo_surface_t, CairoSurfaceRelease>;
using CairoContextPtr = std::unique_ptr<cairo_t, CairoContextRelease>;
using CairoPatternPtr = std::unique_ptr<cairo_pattern_t, CairoPatternRelease>;
using PangoLayoutPtr = std::unique_ptr<PangoLayout, GObjectRelease>;
using PangoContextPtr = std::unique_ptr<PangoContext, GObjectRelease>;
using FontDescriptionPtr = std::unique_ptr<PangoFontDescription, FontDescriptionRelease>;

// Takes a new reference to `surface`.
inline CairoSurfacePtr ShareSurface(cairo_surface_t* surface) {
  return CairoSurfacePtr(cairo_surface_reference(surface));
}

}  // namespace velkui::pictel::cairo
