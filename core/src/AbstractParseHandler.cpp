#include <velkcore/AbstractParseHandler.h>

#include <expat.h>

#include <algorithm>
#include <memory>
#include <new>
#include <vector>

namespace velkcore {

struct ParseHandlerCallbacks {
  // Exceptions must not unwind through expat's C frames: the first one is kept,
  // the parser is stopped, and Parse rethrows it once expat has returned.
  template <typename Body>
  static void Guarded(void* userData, Body&& body) {
    auto* handler = static_cast<AbstractParseHandler*>(userData);
    if (handler->pendingError_) return;  // expat may still deliver a few events after a stop
    try {
      body(*handler);
    } catch (...) {
      handler->pendingError_ = std::current_exception();
      XML_StopParser(handler->parser_, XML_FALSE);
    }
  }

  static void OnStartElement(void* userData, const XML_Char* name, const XML_Char** attributes) {
    Guarded(userData, [&](AbstractParseHandler& handler) {
      std::vector<XMLAttribute> list;
      for (const XML_Char** a = attributes; a[0] != nullptr; a += 2) list.push_back({a[0], a[1]});
      handler.StartElement(name, list);
    });
  }

  static void OnEndElement(void* userData, const XML_Char* name) {
    Guarded(userData, [&](AbstractParseHandler& handler) { handler.EndElement(name); });
  }

  static void OnCharacterData(void* userData, const XML_Char* text, int length) {
    Guarded(userData, [&](AbstractParseHandler& handler) {
      handler.CharacterData(std::string_view(text, static_cast<std::size_t>(length)));
    });
  }

  static void OnStartDoctype(void* userData, const XML_Char*, const XML_Char*, const XML_Char*,
                             int) {
    Guarded(userData, [](AbstractParseHandler& handler) {
      AbstractParseHandler::RaiseAt(handler.CurrentPosition(), kXMLDoctypeNotAllowedKey,
                                    kXMLDoctypeNotAllowedNumber);
    });
  }

  static void OnEntityDeclaration(void* userData, const XML_Char*, int, const XML_Char*, int,
                                  const XML_Char*, const XML_Char*, const XML_Char*,
                                  const XML_Char*) {
    OnStartDoctype(userData, nullptr, nullptr, nullptr, 0);
  }
};

namespace {

struct ParserDeleter {
  void operator()(XML_Parser parser) const { XML_ParserFree(parser); }
};
using ParserHandle = std::unique_ptr<XML_ParserStruct, ParserDeleter>;

// XML_Parse takes an int length, so very large documents go in pieces.
constexpr std::size_t kMaxChunk = std::size_t{1} << 30;

XMLPosition PositionOf(XML_Parser parser) {
  return {static_cast<std::uint64_t>(XML_GetCurrentLineNumber(parser)),
          static_cast<std::uint64_t>(XML_GetCurrentColumnNumber(parser)) + 1};
}

}  // namespace

void AbstractParseHandler::Parse(std::string_view xml) {
  RequireInput(parser_ == nullptr);  // not re-entrant
  ParserHandle parser(XML_ParserCreate(nullptr));
  if (!parser) throw std::bad_alloc();
  XML_SetUserData(parser.get(), this);
  XML_SetElementHandler(parser.get(), &ParseHandlerCallbacks::OnStartElement,
                        &ParseHandlerCallbacks::OnEndElement);
  XML_SetCharacterDataHandler(parser.get(), &ParseHandlerCallbacks::OnCharacterData);
  XML_SetStartDoctypeDeclHandler(parser.get(), &ParseHandlerCallbacks::OnStartDoctype);
  XML_SetEntityDeclHandler(parser.get(), &ParseHandlerCallbacks::OnEntityDeclaration);
  XML_SetParamEntityParsing(parser.get(), XML_PARAM_ENTITY_PARSING_NEVER);

  struct ActiveParser {
    AbstractParseHandler& handler;
    ~ActiveParser() {
      handler.parser_ = nullptr;
      handler.pendingError_ = nullptr;
    }
  } active{*this};
  parser_ = parser.get();
  pendingError_ = nullptr;
  StartDocument();

  XML_Status status = XML_STATUS_OK;
  std::size_t offset = 0;
  bool isFinal = false;
  while (!isFinal && status == XML_STATUS_OK) {
    const std::size_t length = std::min(xml.size() - offset, kMaxChunk);
    isFinal = offset + length == xml.size();
    status = XML_Parse(parser.get(), xml.data() + offset, static_cast<int>(length),
                       isFinal ? XML_TRUE : XML_FALSE);
    offset += length;
  }
  if (pendingError_) std::rethrow_exception(pendingError_);
  if (status != XML_STATUS_OK) {
    RaiseAt(PositionOf(parser.get()), kMalformedXMLKey, kMalformedXMLNumber,
            XML_ErrorString(XML_GetErrorCode(parser.get())));
  }
  EndDocument();
}

void AbstractParseHandler::Parse(std::span<const unsigned char> xml) {
  Parse(std::string_view(reinterpret_cast<const char*>(xml.data()), xml.size()));
}

void AbstractParseHandler::CharacterData(std::string_view) {}

void AbstractParseHandler::StartDocument() {}

void AbstractParseHandler::EndDocument() {}

XMLPosition AbstractParseHandler::CurrentPosition() const {
  if (parser_ == nullptr) return {};
  return PositionOf(parser_);
}

void AbstractParseHandler::RaiseAt(const XMLPosition& where, std::string_view key,
                                   std::int32_t number, const ReplacementValue& r2,
                                   const ReplacementValue& r3) {
  RaiseAt(where, key, kCategoryUtilities, number, r2, r3);
}

void AbstractParseHandler::RaiseAt(const XMLPosition& where, std::string_view key,
                                   std::int32_t category, std::int32_t number,
                                   const ReplacementValue& r2, const ReplacementValue& r3) {
  ThrowError(ErrorLevel::kError, key, category, number, 0, static_cast<double>(where.line),
             static_cast<double>(where.column), r2, r3);
}

std::optional<std::string_view> AbstractParseHandler::FindAttribute(
    std::span<const XMLAttribute> attributes, std::string_view name) {
  const auto found = std::find_if(attributes.begin(), attributes.end(),
                                  [&](const XMLAttribute& a) { return a.name == name; });
  if (found == attributes.end()) return std::nullopt;
  return found->value;
}

}  // namespace velkcore
