#pragma once

#include <cstdint>
#include <exception>
#include <optional>
#include <span>
#include <string_view>

#include <velkcore/Error.h>

struct XML_ParserStruct;  // expat's parser, kept out of this header

namespace velkcore {

// A place in an XML document; line and column count from 1, columns in characters.
struct XMLPosition {
  std::uint64_t line = 0;
  std::uint64_t column = 0;

  friend bool operator==(const XMLPosition&, const XMLPosition&) = default;
};

struct XMLAttribute {
  std::string_view name;
  std::string_view value;
};

inline constexpr std::string_view kMalformedXMLKey =
    "$$$/velkcore/XML/Error/Malformed=Malformed XML at line ^0, column ^1: ^2.";
inline constexpr std::string_view kXMLDoctypeNotAllowedKey =
    "$$$/velkcore/XML/Error/DoctypeNotAllowed=Document type declarations are not accepted (line "
    "^0, column ^1).";
inline constexpr std::int32_t kMalformedXMLNumber = 40;
inline constexpr std::int32_t kXMLDoctypeNotAllowedNumber = 41;

// Event-driven XML parsing over expat. Derived classes receive the elements
// and text of a document as it is read; they report bad content by throwing
// (RaiseAt adds the position), and Parse passes that exception on unchanged.
//
// Document type declarations are refused outright, so no entity can be
// declared and nothing can expand. Element and attribute names are passed on
// as written (no namespace processing); all text arrives as UTF-8.
class AbstractParseHandler {
 public:
  AbstractParseHandler() = default;
  AbstractParseHandler(const AbstractParseHandler&) = delete;
  AbstractParseHandler& operator=(const AbstractParseHandler&) = delete;
  virtual ~AbstractParseHandler() = default;

  // Parses one complete document. Malformed XML raises kMalformedXMLKey with
  // the line and column of the fault; a DOCTYPE raises kXMLDoctypeNotAllowedKey.
  void Parse(std::string_view xml);
  void Parse(std::span<const unsigned char> xml);

 protected:
  virtual void StartElement(std::string_view name, std::span<const XMLAttribute> attributes) = 0;
  virtual void EndElement(std::string_view name) = 0;
  // Text may arrive in several pieces for one run of text.
  virtual void CharacterData(std::string_view text);
  // Called once before the first event of every Parse, so a handler can reset itself.
  virtual void StartDocument();
  // Called once after the whole document was read without fault.
  virtual void EndDocument();

  // The position of the event being handled; only meaningful inside a callback.
  XMLPosition CurrentPosition() const;

  // Throws an error whose text has the line in "^0" and the column in "^1";
  // `r2` and `r3` fill "^2" and "^3".
  [[noreturn]] static void RaiseAt(const XMLPosition& where, std::string_view key,
                                   std::int32_t number, const ReplacementValue& r2 = {},
                                   const ReplacementValue& r3 = {});
  [[noreturn]] static void RaiseAt(const XMLPosition& where, std::string_view key,
                                   std::int32_t category, std::int32_t number,
                                   const ReplacementValue& r2, const ReplacementValue& r3);

  // The value of the named attribute, if the element has it.
  static std::optional<std::string_view> FindAttribute(std::span<const XMLAttribute> attributes,
                                                       std::string_view name);

 private:
  friend struct ParseHandlerCallbacks;

  XML_ParserStruct* parser_ = nullptr;  // only while Parse runs
  std::exception_ptr pendingError_;
};

}  // namespace velkcore
