#pragma once

#include "GalleryCanvas.h"

namespace gallery {

// Each section draws inside the inner area of its card.
void DrawShapes(GalleryCanvas& canvas, const RectT<float>& area);
void DrawStrokes(GalleryCanvas& canvas, const RectT<float>& area);
void DrawGradientsAndColour(GalleryCanvas& canvas, const RectT<float>& area);
void DrawTypography(GalleryCanvas& canvas, const RectT<float>& area);
void DrawImages(GalleryCanvas& canvas, const RectT<float>& area);
void DrawPixelLayouts(GalleryCanvas& canvas, const RectT<float>& area);

}  // namespace gallery
