#include <velkcore/PropListXML.h>

#include <velkcore/Error.h>

#include "PropListText.h"

namespace velkcore {
namespace {

using namespace proplist_text;

class PropListWriter {
 public:
  std::string Write(const PropList& list) {
    out_ = "<?xml version=\"1.0\" encoding=\"UTF-8\"?>\n<prop.map version=\"4\">\n";
    WriteList(list, 1, 1, {});
    out_ += "</prop.map>\n";
    return std::move(out_);
  }

 private:
  void Indent(std::size_t level) { out_.append(2 * level, ' '); }

  void WriteList(const PropList& list, std::size_t level, std::size_t depth, std::string_view key) {
    if (depth > kMaxPropListDepth) {
      ThrowError(ErrorLevel::kError, kPropListWriteTooDeepKey, kCategoryUtilities,
                 kPropListWriteTooDeepNumber, 0, key, static_cast<double>(kMaxPropListDepth));
    }
    Indent(level);
    if (list.Empty()) {
      out_ += "<prop.list/>\n";
      return;
    }
    out_ += "<prop.list>\n";
    for (const auto& [entryKey, value] : list) {
      Indent(level + 1);
      out_ += "<prop.pair>\n";
      Indent(level + 2);
      WriteText("key", entryKey);
      out_ += '\n';
      WriteValue(entryKey, value, level + 2, depth);
      Indent(level + 1);
      out_ += "</prop.pair>\n";
    }
    Indent(level);
    out_ += "</prop.list>\n";
  }

  void WriteValue(std::string_view key, const PropValue& value, std::size_t level,
                  std::size_t depth) {
    if (const PropList* list = value.GetIf<PropList>()) {
      WriteList(*list, level, depth + 1, key);
      return;
    }
    Indent(level);
    switch (value.GetType()) {
      case PropType::kBool:
        out_ += *value.GetIf<bool>() ? "<true/>" : "<false/>";
        break;
      case PropType::kInt32:
        WriteNumber("<int type=\"signed\" size=\"32\">", *value.GetIf<std::int32_t>(), "</int>");
        break;
      case PropType::kUInt32:
        WriteNumber("<int type=\"unsigned\" size=\"32\">", *value.GetIf<std::uint32_t>(), "</int>");
        break;
      case PropType::kUInt16:
        WriteNumber("<int type=\"unsigned\" size=\"16\">", *value.GetIf<std::uint16_t>(), "</int>");
        break;
      case PropType::kFloat:
        out_ += "<float>" + FormatFloat(*value.GetIf<float>()) + "</float>";
        break;
      case PropType::kDouble:
        out_ += "<float size=\"64\">" + FormatFloat(*value.GetIf<double>()) + "</float>";
        break;
      case PropType::kString:
        WriteText("string", *value.GetIf<std::string>());
        break;
      case PropType::kUString:
        WriteText(*value.GetIf<UTF16String>());
        break;
      case PropType::kUStringArray:
        WriteArray(*value.GetIf<UTF16StringArray>(), level);
        break;
      case PropType::kList:
        break;  // handled above
    }
    out_ += '\n';
  }

  template <typename I>
  void WriteNumber(std::string_view open, I number, std::string_view close) {
    out_ += open;
    out_ += std::to_string(number);
    out_ += close;
  }

  void WriteArray(const UTF16StringArray& items, std::size_t level) {
    out_ += "<array>\n";
    Indent(level + 1);
    out_ += "<array.type><ustring/></array.type>\n";
    for (const UTF16String& item : items) {
      Indent(level + 1);
      WriteText(item);
      out_ += '\n';
    }
    Indent(level);
    out_ += "</array>";
  }

  void WriteText(std::string_view element, std::string_view utf8) {
    if (IsCarriable(utf8)) {
      WriteElement(element, {}, utf8);
    } else {
      WriteElement(element, " encoding=\"hex\"", HexOfBytes(utf8));
    }
  }

  void WriteText(std::u16string_view text) {
    if (IsCarriable(text)) {
      WriteElement("ustring", {}, UTF16to8(text));
    } else {
      WriteElement("ustring", " encoding=\"hex\"", HexOfUnits(text));
    }
  }

  void WriteElement(std::string_view element, std::string_view attributes,
                    std::string_view content) {
    out_ += '<';
    out_ += element;
    out_ += attributes;
    out_ += '>';
    AppendEscaped(content);
    out_ += "</";
    out_ += element;
    out_ += '>';
  }

  // Tab and line feed survive as they are; a literal carriage return would be
  // turned into a line feed by any XML reader, so it becomes a reference.
  void AppendEscaped(std::string_view text) {
    for (const char c : text) {
      switch (c) {
        case '&':
          out_ += "&amp;";
          break;
        case '<':
          out_ += "&lt;";
          break;
        case '>':
          out_ += "&gt;";
          break;
        case '\r':
          out_ += "&#13;";
          break;
        default:
          out_ += c;
      }
    }
  }

  std::string out_;
};

}  // namespace

std::string WritePropList(const PropList& list) {
  return PropListWriter().Write(list);
}

}  // namespace velkcore
