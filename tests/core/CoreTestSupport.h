#pragma once

#include <functional>
#include <optional>
#include <string>

#include <gtest/gtest.h>

#include <velkcore/Error.h>

namespace velkcore_test {

// The library error `action` raised, if any.
inline std::optional<velkcore::Exception> ErrorOf(const std::function<void()>& action) {
  try {
    action();
  } catch (const velkcore::Exception& e) {
    return e;
  }
  return std::nullopt;
}

enum class Match { kPart, kWhole };

// Whether `action` raised the error `key` (any key when empty) with a message containing
// `message`, or equal to it with Match::kWhole.
inline ::testing::AssertionResult Raises(const std::function<void()>& action, std::string_view key,
                                         const std::string& message = "",
                                         Match match = Match::kPart) {
  const auto error = ErrorOf(action);
  if (!error) return ::testing::AssertionFailure() << "no error";
  const std::string what = error->what();
  if (!key.empty() && error->GetKey() != key) {
    return ::testing::AssertionFailure() << "key " << error->GetKey() << ": " << what;
  }
  if (match == Match::kWhole ? what != message : what.find(message) == std::string::npos) {
    return ::testing::AssertionFailure() << "message: " << what;
  }
  return ::testing::AssertionSuccess();
}

}  // namespace velkcore_test
