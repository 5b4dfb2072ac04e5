#pragma once

#include <functional>
#include <optional>

#include <gtest/gtest.h>

#include <velkcore/Error.h>

namespace velkui::test {

// The error `action` raises, if it raises one.
inline std::optional<velkcore::Exception> ErrorOf(const std::function<void()>& action) {
  try {
    action();
  } catch (const velkcore::Exception& e) {
    return e;
  }
  return std::nullopt;
}

// Whether `action` raises the contract violation of bad input.
inline ::testing::AssertionResult RaisesContractViolation(const std::function<void()>& action) {
  const std::optional<velkcore::Exception> error = ErrorOf(action);
  if (!error) return ::testing::AssertionFailure() << "no error raised";
  if (error->GetLevel() != velkcore::ErrorLevel::kContractViolation ||
      error->GetCategory() != velkcore::kCategoryUtilities ||
      error->GetNumber() != velkcore::kInputContractViolationNumber) {
    return ::testing::AssertionFailure() << "another error: " << error->what();
  }
  return ::testing::AssertionSuccess();
}

}  // namespace velkui::test
