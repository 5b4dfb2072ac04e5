#pragma once

#include <optional>
#include <string>
#include <string_view>
#include <vector>

#include <gtest/gtest.h>

#include <velkcore/Error.h>
#include <velkui/pictel/PictelHandles.h>
#include <velkui/test/ErrorOf.h>
#include <velkui/test/RecordingSupplier.h>

namespace velkui::pictel::test {

// The drawing error (category 101, level error) `action` raised, if any.
template <typename Action>
std::optional<velkcore::Exception> DrawingError(Action action) {
  auto error = velkui::test::ErrorOf(action);
  if (error) {
    EXPECT_EQ(101, error->GetCategory());
    EXPECT_EQ(velkcore::ErrorLevel::kError, error->GetLevel());
  }
  return error;
}

// The number of the drawing error `action` raised, 0 for none.
template <typename Action>
int ErrorNumber(Action action) {
  const auto error = DrawingError(action);
  return error ? error->GetNumber() : 0;
}

// Whether `action` raised the drawing error `number` under `key`.
template <typename Action>
::testing::AssertionResult RaisesDrawingError(Action action, int number, std::string_view key) {
  const auto error = DrawingError(action);
  if (!error) return ::testing::AssertionFailure() << "no error";
  if (error->GetNumber() != number || error->GetKey() != key) {
    return ::testing::AssertionFailure()
           << "error " << error->GetNumber() << " " << error->GetKey();
  }
  return ::testing::AssertionSuccess();
}

// A recording supplier with a logged surface of 200 × 100 pixels, a font whose characters are
// 5 units wide (ascent 8, descent 2) and a black brush.
class RecordingSurfaceTest : public ::testing::Test {
 protected:
  boost::intrusive_ptr<velkui::test::RecordingSupplier> supplier{
      new velkui::test::RecordingSupplier()};
  SurfaceP surface{*supplier, 200, 100};
  FontP font{*supplier, u"Fixed", u"", 10.0f};
  BrushP brush{*supplier, {0, 0, 0, 1}};

  // The drawing calls of every surface.
  std::vector<std::string> Drawn() const { return supplier->GetLog().Strings(0, true); }
};

}  // namespace velkui::pictel::test
