#pragma once

#include <cstdint>
#include <filesystem>
#include <string>

#include <gtest/gtest.h>

#include <velkui/pictel/ImageInterface.h>

namespace velkui::test {

// How far an image may stray from its reference: a pixel differs when one of
// its channels is off by more than `channel`; the comparison fails when more
// than `fraction` of the pixels differ (or the sizes differ).
struct GoldenTolerance {
  int channel = 0;
  double fraction = 0.0;
};

// Compares an image made by the platform supplier with `<directory>/<name>.png`.
// Both go through the same PNG encoding, so an exact match is possible.
// On failure the actual image and an amplified difference are written to
// <build>/golden-output/<name>.actual.png and <name>.diff.png.
// With VELKUI_UPDATE_GOLDEN=1 in the environment the reference is (re)written
// from the actual image instead, and the comparison passes.
::testing::AssertionResult MatchesGolden(const pictel::ImageInterface& actual,
                                         const std::filesystem::path& directory,
                                         const std::string& name, GoldenTolerance tolerance = {});

// Where failed comparisons leave their images.
std::filesystem::path GoldenOutputDirectory();

}  // namespace velkui::test
