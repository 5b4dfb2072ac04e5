#include <velkui/test/GoldenImage.h>

#include <algorithm>
#include <cstdlib>
#include <fstream>
#include <iterator>
#include <sstream>
#include <vector>

#include <velkui/pictel/ImageIO.h>
#include <velkui/pictel/MemBuffer.h>
#include <velkui/pictel/OSSupplier.h>
#include <velkui/pictel/SupplierInterface.h>

namespace velkui::test {

namespace {

namespace fs = std::filesystem;
using pictel::PixelLayout;

bool UpdateRequested() {
  const char* flag = std::getenv("VELKUI_UPDATE_GOLDEN");
  return flag != nullptr && std::string(flag) == "1";
}

std::vector<std::uint8_t> ReadFile(const fs::path& file) {
  std::ifstream in(file, std::ios::binary);
  return std::vector<std::uint8_t>(std::istreambuf_iterator<char>(in), {});
}

void WriteFile(const fs::path& file, const std::vector<std::uint8_t>& bytes) {
  fs::create_directories(file.parent_path());
  std::ofstream out(file, std::ios::binary | std::ios::trunc);
  out.write(reinterpret_cast<const char*>(bytes.data()), static_cast<std::streamsize>(bytes.size()));
}

// Straight-alpha BGRA pixels of an encoded PNG.
boost::intrusive_ptr<pictel::MemBuffer> Decode(const pictel::SupplierInterface& supplier,
                                               const std::vector<std::uint8_t>& png) {
  const auto image = supplier.NewFileImage(png.data(), png.size(), pictel::ImageFileType::kPNG);
  return pictel::CopyImagePixels(*image, PixelLayout::kBGRA);
}

struct Difference {
  std::int64_t differing = 0;
  int largest = 0;
};

Difference Compare(const pictel::MemBuffer& actual, const pictel::MemBuffer& expected,
                   int channelTolerance, std::vector<std::uint8_t>* amplified) {
  Difference result;
  const std::size_t size = actual.GetDataSize();
  amplified->assign(size, 0);
  const std::uint8_t* a = actual.GetData();
  const std::uint8_t* e = expected.GetData();
  for (std::size_t i = 0; i < size; i += 4) {
    int worst = 0;
    for (std::size_t c = 0; c < 4; ++c) {
      const int delta = std::abs(int{a[i + c]} - int{e[i + c]});
      worst = std::max(worst, delta);
      (*amplified)[i + c] = static_cast<std::uint8_t>(std::min(255, delta * 16));
    }
    // Unchanged pixels show as a dim grey so the picture stays readable.
    if (worst == 0) {
      (*amplified)[i] = (*amplified)[i + 1] = (*amplified)[i + 2] = 32;
    }
    (*amplified)[i + 3] = 255;
    result.largest = std::max(result.largest, worst);
    if (worst > channelTolerance) ++result.differing;
  }
  return result;
}

}  // namespace

fs::path GoldenOutputDirectory() { return fs::path(VELKUI_GOLDEN_OUTPUT_DIR); }

::testing::AssertionResult MatchesGolden(const pictel::ImageInterface& actual,
                                         const fs::path& directory, const std::string& name,
                                         GoldenTolerance tolerance) {
  const auto supplier = pictel::NewOSSupplier();
  const std::vector<std::uint8_t> actualPNG = pictel::EncodeImageAsPNG(actual);
  const fs::path reference = directory / (name + ".png");
  const fs::path actualOut = GoldenOutputDirectory() / (name + ".actual.png");
  const fs::path diffOut = GoldenOutputDirectory() / (name + ".diff.png");

  if (UpdateRequested()) {
    WriteFile(reference, actualPNG);
    return ::testing::AssertionSuccess() << "reference written: " << reference;
  }
  if (!fs::exists(reference)) {
    WriteFile(actualOut, actualPNG);
    return ::testing::AssertionFailure()
           << "no reference " << reference << "; actual image written to " << actualOut
           << " (run with VELKUI_UPDATE_GOLDEN=1 to accept it)";
  }

  const auto got = Decode(*supplier, actualPNG);
  const auto expected = Decode(*supplier, ReadFile(reference));
  if (got->GetWidth() != expected->GetWidth() || got->GetHeight() != expected->GetHeight()) {
    WriteFile(actualOut, actualPNG);
    return ::testing::AssertionFailure()
           << name << ": size " << got->GetWidth() << "x" << got->GetHeight() << ", reference "
           << expected->GetWidth() << "x" << expected->GetHeight() << "; actual in " << actualOut;
  }
  std::vector<std::uint8_t> amplified;
  const Difference difference = Compare(*got, *expected, tolerance.channel, &amplified);
  const double pixels = static_cast<double>(got->GetWidth()) * got->GetHeight();
  const double fraction = pixels > 0 ? static_cast<double>(difference.differing) / pixels : 0.0;
  if (fraction <= tolerance.fraction) return ::testing::AssertionSuccess();

  WriteFile(actualOut, actualPNG);
  const auto diffImage =
      supplier->NewBufferImage(got->GetWidth(), got->GetHeight(), got->GetRowBytes(),
                               PixelLayout::kBGRA, amplified.data(), {});
  pictel::WriteImageToPNGFile(*diffImage, diffOut);
  return ::testing::AssertionFailure()
         << name << ": " << difference.differing << " pixels differ (" << fraction * 100
         << "%, largest channel difference " << difference.largest << "); allowed "
         << tolerance.fraction * 100 << "% beyond " << tolerance.channel << ". Actual: "
         << actualOut << ", amplified difference: " << diffOut;
}

}  // namespace velkui::test
