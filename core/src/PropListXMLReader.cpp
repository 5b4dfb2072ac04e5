#include <velkcore/AbstractParseHandler.h>
#include <velkcore/PropListXML.h>

#include <algorithm>
#include <initializer_list>
#include <vector>

#include "PropListText.h"

namespace velkcore {
namespace {

using namespace proplist_text;

// What an open element of the document is, as far as the reader is concerned.
enum class Node {
  kDocument,
  kMap,
  kList,
  kPair,
  kKey,
  kBool,
  kNumber,
  kString,
  kUString,
  kArray,
  kArrayType,
  kArrayTypeItem,
  kArrayItem,
};

struct Frame {
  Frame(Node kind, std::string_view elementName, const XMLPosition& where)
      : node(kind), name(elementName), start(where) {}

  Node node;
  std::string_view name;  // a literal, for messages
  XMLPosition start;
  PropList* list = nullptr;  // kList: the list being filled; kPair: the list receiving the pair
  std::string key;           // kPair
  bool hasKey = false;       // kPair
  bool hasValue = false;     // kPair
  bool hasPart = false;      // kMap: its list; kArray: its array.type; kArrayType: its item type
  bool boolValue = false;    // kBool
  PropType numberType = PropType::kInt32;  // kNumber
  bool hex = false;                        // kKey, kString, kUString, kArrayItem
  UTF16StringArray items;                  // kArray
};

// Document text quoted in a message, cut short so the message stays readable.
std::string Shown(std::string_view text) {
  constexpr std::size_t kLongest = 40;
  if (text.size() <= kLongest) return std::string(text);
  return std::string(text.substr(0, kLongest)) + "...";
}

// Leaves carry text; every other element holds only elements and white space.
bool IsLeaf(Node node) {
  return node == Node::kKey || node == Node::kNumber || node == Node::kString ||
         node == Node::kUString || node == Node::kArrayItem;
}

class PropListReader final : public AbstractParseHandler {
 public:
  PropList Read(std::string_view xml) {
    frames_.emplace_back(Node::kDocument, "document", XMLPosition{});
    Parse(xml);
    return std::move(result_);
  }

 private:
  using Attributes = std::span<const XMLAttribute>;

  void StartElement(std::string_view name, Attributes attributes) override {
    const XMLPosition where = CurrentPosition();
    Frame& parent = frames_.back();
    switch (parent.node) {
      case Node::kDocument:
        return StartMap(name, attributes, where);
      case Node::kMap:
        return StartRootList(parent, name, attributes, where);
      case Node::kList:
        return StartPair(parent, name, attributes, where);
      case Node::kPair:
        return StartInPair(parent, name, attributes, where);
      case Node::kArray:
        return StartInArray(parent, name, attributes, where);
      case Node::kArrayType:
        return StartItemType(parent, name, attributes, where);
      default:
        RaiseUnexpectedElement(name, where);
    }
  }

  void EndElement(std::string_view) override {
    Frame frame = std::move(frames_.back());
    frames_.pop_back();
    Frame& parent = frames_.back();
    switch (frame.node) {
      case Node::kDocument:
        break;
      case Node::kMap:
        RequirePart(frame, frame.hasPart, "prop.list");
        break;
      case Node::kList:
        --listDepth_;
        break;
      case Node::kPair:
        RequirePart(frame, frame.hasKey, "key");
        RequirePart(frame, frame.hasValue, "value");
        break;
      case Node::kKey:
        EndKey(frame, parent);
        break;
      case Node::kBool:
        StoreValue(parent, PropValue(frame.boolValue));
        break;
      case Node::kNumber:
        StoreValue(parent, ParseNumber(frame));
        break;
      case Node::kString:
        StoreValue(parent, PropValue(DecodeBytes(frame)));
        break;
      case Node::kUString:
        StoreValue(parent, PropValue(DecodeUnits(frame)));
        break;
      case Node::kArray:
        RequirePart(frame, frame.hasPart, "array.type");
        StoreValue(parent, PropValue(std::move(frame.items)));
        break;
      case Node::kArrayType:
        RequirePart(frame, frame.hasPart, "item type");
        parent.hasPart = true;
        break;
      case Node::kArrayTypeItem:
        parent.hasPart = true;
        break;
      case Node::kArrayItem:
        parent.items.push_back(DecodeUnits(frame));
        break;
    }
  }

  void CharacterData(std::string_view text) override {
    if (IsLeaf(frames_.back().node)) {
      text_.append(text);
    } else if (!IsAllXMLSpace(text)) {
      RaiseAt(CurrentPosition(), kPropListUnexpectedTextKey, kPropListUnexpectedTextNumber);
    }
  }

  // ---- starting elements, by parent ----

  void StartMap(std::string_view name, Attributes attributes, const XMLPosition& where) {
    if (name != "prop.map") RaiseUnexpectedElement(name, where);
    RequireOnlyAttributes(attributes, {"version"}, where);
    const std::string_view version = RequireAttribute(attributes, "version", where);
    if (version != "4") RaiseBadAttribute("version", version, where);
    Push(Node::kMap, "prop.map", where);
  }

  void StartRootList(Frame& map, std::string_view name, Attributes attributes,
                     const XMLPosition& where) {
    if (name != "prop.list" || map.hasPart) RaiseUnexpectedElement(name, where);
    map.hasPart = true;
    PushList(&result_, attributes, where);
  }

  void StartPair(Frame& list, std::string_view name, Attributes attributes,
                 const XMLPosition& where) {
    if (name != "prop.pair") RaiseUnexpectedElement(name, where);
    RequireOnlyAttributes(attributes, {}, where);
    PropList* owner = list.list;
    Push(Node::kPair, "prop.pair", where).list = owner;
  }

  void StartInPair(Frame& pair, std::string_view name, Attributes attributes,
                   const XMLPosition& where) {
    if (!pair.hasKey) {
      if (name != "key") RaiseMissingPart(pair, "key");
      RequireOnlyAttributes(attributes, {"encoding"}, where);
      const bool hex = IsHexEncoded(attributes, where);
      Push(Node::kKey, "key", where).hex = hex;
      return;
    }
    if (pair.hasValue) RaiseUnexpectedElement(name, where);
    StartValue(pair, name, attributes, where);
  }

  void StartValue(Frame& pair, std::string_view name, Attributes attributes,
                  const XMLPosition& where) {
    if (name == "prop.list") {
      pair.hasValue = true;
      PropList* list = pair.list->NewSubList(pair.key);
      return PushList(list, attributes, where);
    }
    if (name == "true" || name == "false") {
      RequireOnlyAttributes(attributes, {}, where);
      Push(Node::kBool, name == "true" ? "true" : "false", where).boolValue = name == "true";
    } else if (name == "int") {
      RequireOnlyAttributes(attributes, {"type", "size"}, where);
      const PropType type = IntegerType(attributes, where);
      Push(Node::kNumber, "int", where).numberType = type;
    } else if (name == "float") {
      RequireOnlyAttributes(attributes, {"size"}, where);
      const PropType type = FloatType(attributes, where);
      Push(Node::kNumber, "float", where).numberType = type;
    } else if (name == "string" || name == "ustring") {
      RequireOnlyAttributes(attributes, {"encoding"}, where);
      const bool hex = IsHexEncoded(attributes, where);
      const bool utf8 = name == "string";
      Push(utf8 ? Node::kString : Node::kUString, utf8 ? "string" : "ustring", where).hex = hex;
    } else if (name == "array") {
      RequireOnlyAttributes(attributes, {}, where);
      Push(Node::kArray, "array", where);
    } else {
      RaiseUnexpectedElement(name, where);
    }
  }

  void StartInArray(Frame& array, std::string_view name, Attributes attributes,
                    const XMLPosition& where) {
    if (!array.hasPart) {
      if (name != "array.type") RaiseMissingPart(array, "array.type");
      RequireOnlyAttributes(attributes, {}, where);
      Push(Node::kArrayType, "array.type", where);
      return;
    }
    if (name != "ustring") RaiseUnexpectedElement(name, where);
    RequireOnlyAttributes(attributes, {"encoding"}, where);
    const bool hex = IsHexEncoded(attributes, where);
    Push(Node::kArrayItem, "ustring", where).hex = hex;
  }

  // Arrays of ustring are the only arrays a PropList holds.
  void StartItemType(Frame& type, std::string_view name, Attributes attributes,
                     const XMLPosition& where) {
    if (type.hasPart || name != "ustring") RaiseUnexpectedElement(name, where);
    RequireOnlyAttributes(attributes, {}, where);
    Push(Node::kArrayTypeItem, "ustring", where);
  }

  Frame& Push(Node node, std::string_view name, const XMLPosition& where) {
    text_.clear();
    return frames_.emplace_back(node, name, where);
  }

  void PushList(PropList* list, Attributes attributes, const XMLPosition& where) {
    RequireOnlyAttributes(attributes, {}, where);
    if (listDepth_ == kMaxPropListDepth) {
      RaiseAt(where, kPropListTooDeepKey, kPropListTooDeepNumber,
              static_cast<double>(kMaxPropListDepth));
    }
    ++listDepth_;
    Push(Node::kList, "prop.list", where).list = list;
  }

  // ---- finishing elements ----

  void EndKey(const Frame& keyFrame, Frame& pair) {
    std::string key = DecodeBytes(keyFrame);
    if (pair.list->HasKey(key)) {
      RaiseAt(keyFrame.start, kPropListDuplicateKeyKey, kPropListDuplicateKeyNumber, Shown(key));
    }
    pair.key = std::move(key);
    pair.hasKey = true;
  }

  void StoreValue(Frame& pair, PropValue value) {
    pair.list->Set(pair.key, std::move(value));
    pair.hasValue = true;
  }

  PropValue ParseNumber(const Frame& frame) const {
    switch (frame.numberType) {
      case PropType::kInt32:
        return Parsed(frame, ParseInt32(text_));
      case PropType::kUInt32:
        return Parsed(frame, ParseUInt32(text_));
      case PropType::kUInt16:
        return Parsed(frame, ParseUInt16(text_));
      case PropType::kFloat:
        return Parsed(frame, ParseFloat(text_));
      default:
        return Parsed(frame, ParseDouble(text_));
    }
  }

  template <typename T>
  PropValue Parsed(const Frame& frame, const std::optional<T>& number) const {
    if (!number) {
      RaiseAt(frame.start, kPropListBadNumberKey, kPropListBadNumberNumber, Shown(text_),
              PropTypeName(frame.numberType));
    }
    return PropValue(*number);
  }

  std::string DecodeBytes(const Frame& frame) const {
    if (!frame.hex) return text_;
    auto bytes = BytesOfHex(text_);
    if (!bytes) RaiseAt(frame.start, kPropListBadEncodedTextKey, kPropListBadEncodedTextNumber);
    return std::move(*bytes);
  }

  UTF16String DecodeUnits(const Frame& frame) const {
    if (!frame.hex) return UTF8to16(text_);
    auto units = UnitsOfHex(text_);
    if (!units) RaiseAt(frame.start, kPropListBadEncodedTextKey, kPropListBadEncodedTextNumber);
    return std::move(*units);
  }

  // ---- attributes ----

  static void RequireOnlyAttributes(Attributes attributes,
                                    std::initializer_list<std::string_view> allowed,
                                    const XMLPosition& where) {
    for (const XMLAttribute& attribute : attributes) {
      if (std::find(allowed.begin(), allowed.end(), attribute.name) == allowed.end()) {
        RaiseAt(where, kPropListUnexpectedAttributeKey, kPropListUnexpectedAttributeNumber,
                Shown(attribute.name));
      }
    }
  }

  static std::string_view RequireAttribute(Attributes attributes, std::string_view name,
                                           const XMLPosition& where) {
    const auto value = FindAttribute(attributes, name);
    if (!value) {
      RaiseAt(where, kPropListMissingAttributeKey, kPropListMissingAttributeNumber, name);
    }
    return *value;
  }

  static bool IsHexEncoded(Attributes attributes, const XMLPosition& where) {
    const auto encoding = FindAttribute(attributes, "encoding");
    if (!encoding) return false;
    if (*encoding != "hex") RaiseBadAttribute("encoding", *encoding, where);
    return true;
  }

  static PropType IntegerType(Attributes attributes, const XMLPosition& where) {
    const std::string_view type = RequireAttribute(attributes, "type", where);
    const std::string_view size = RequireAttribute(attributes, "size", where);
    if (type != "signed" && type != "unsigned") RaiseBadAttribute("type", type, where);
    if (size == "32") return type == "signed" ? PropType::kInt32 : PropType::kUInt32;
    if (size == "16" && type == "unsigned") return PropType::kUInt16;
    RaiseBadAttribute("size", size, where);
  }

  static PropType FloatType(Attributes attributes, const XMLPosition& where) {
    const auto size = FindAttribute(attributes, "size");
    if (!size || *size == "32") return PropType::kFloat;
    if (*size == "64") return PropType::kDouble;
    RaiseBadAttribute("size", *size, where);
  }

  // ---- errors ----

  [[noreturn]] static void RaiseUnexpectedElement(std::string_view name, const XMLPosition& where) {
    RaiseAt(where, kPropListUnexpectedElementKey, kPropListUnexpectedElementNumber, Shown(name));
  }

  [[noreturn]] static void RaiseBadAttribute(std::string_view name, std::string_view value,
                                             const XMLPosition& where) {
    RaiseAt(where, kPropListBadAttributeKey, kPropListBadAttributeNumber, name, Shown(value));
  }

  [[noreturn]] static void RaiseMissingPart(const Frame& frame, std::string_view part) {
    RaiseAt(frame.start, kPropListMissingPartKey, kPropListMissingPartNumber, part, frame.name);
  }

  static void RequirePart(const Frame& frame, bool present, std::string_view part) {
    if (!present) RaiseMissingPart(frame, part);
  }

  std::vector<Frame> frames_;
  std::string text_;  // of the open leaf element
  std::size_t listDepth_ = 0;
  PropList result_;
};

}  // namespace

PropList ReadPropList(std::string_view xml) {
  return PropListReader().Read(xml);
}

PropList ReadPropList(std::span<const unsigned char> xml) {
  return ReadPropList(std::string_view(reinterpret_cast<const char*>(xml.data()), xml.size()));
}

}  // namespace velkcore
