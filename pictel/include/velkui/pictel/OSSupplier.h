#pragma once

#include <boost/intrusive_ptr.hpp>

#include <velkui/pictel/SupplierInterface.h>

namespace velkui::pictel {

// The platform supplier (Cairo for geometry and images, Pango for text).
//
// Its surfaces start with anti-aliasing on, high-quality interpolation and the
// anti-aliased text-display policy. Glyphs are smoothed in grey without hinting
// whatever the text-display policy (only anti-aliasing off makes them one bit
// per pixel), so that text looks and measures the same on every machine.
// Buffers and images take the layouts 1, 3, 6 and 7; 3 and 7 are used in place
// (when rows are a multiple of 4 bytes), the others through a shadow copy,
// written back to a buffer surface's memory on Flush and when the surface dies,
// read once when a buffer image is made.
boost::intrusive_ptr<SupplierInterface> NewOSSupplier();

// Whether `supplier` is the platform supplier.
bool IsOSSupplier(const SupplierInterface& supplier);

// The platform's user-interface face: the first of "Tahoma", "DejaVu Sans" that
// the font configuration has ("Sans" when neither is installed).
velkcore::UTF16String GetPlatformUIFontFamily();

// Whether the font configuration has `family` (exact, case-insensitive name).
bool HasFontFamily(const velkcore::UTF16String& family);

}  // namespace velkui::pictel
