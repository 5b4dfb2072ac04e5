#pragma once

#include <optional>
#include <string>
#include <string_view>

#include <gtest/gtest.h>

#include <velkcore/Error.h>

namespace velkui::pictel::test {

// The drawing error (category 101, level error) `action` raised, if any.
template <typename Action>
std::optional<velkcore::Exception> DrawingError(Action action) {
  try {
    action();
  } catch (const velkcore::Exception& e) {
    EXPECT_EQ(101, e.GetCategory());
    EXPECT_EQ(velkcore::ErrorLevel::kError, e.GetLevel());
    return e;
  }
  return std::nullopt;
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

}  // namespace velkui::pictel::test
