#include <velkcore/PropListXML.h>

#include <cstdint>
#include <cstdlib>
#include <string>
#include <string_view>

// Any input either raises velkcore::Exception or reads as a list that writes
// back to text which reads as the same list and writes the same text again.
extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
  const std::string_view input(reinterpret_cast<const char*>(data), size);
  velkcore::PropList list;
  try {
    list = velkcore::ReadPropList(input);
  } catch (const velkcore::Exception&) {
    return 0;
  }
  const std::string written = velkcore::WritePropList(list);
  const velkcore::PropList reread = velkcore::ReadPropList(written);
  if (!(reread == list) || velkcore::WritePropList(reread) != written) std::abort();
  return 0;
}
