#pragma once

#include <boost/intrusive_ptr.hpp>

#include <velkui/pictel/SupplierInterface.h>

namespace velkui::pictel {

// The platform supplier (Cairo for geometry and images, Pango for text).
boost::intrusive_ptr<SupplierInterface> NewOSSupplier();

// Whether `supplier` is the platform supplier.
bool IsOSSupplier(const SupplierInterface& supplier);

// The platform's user-interface face: the first of "Tahoma", "DejaVu Sans" that
// the font configuration has ("Sans" when neither is installed).
velkcore::UTF16String GetPlatformUIFontFamily();

// Whether the font configuration has `family` (exact, case-insensitive name).
bool HasFontFamily(const velkcore::UTF16String& family);

}  // namespace velkui::pictel
