#include "X11Clipboard.h"

#include <X11/Xatom.h>
#include <poll.h>
#include "X11Headers.h"

#include <algorithm>
#include <chrono>
#include <cstring>

#include <velkcore/Error.h>
#include <velkcore/Strings.h>

namespace velkui::ui::x11 {

namespace {

constexpr std::string_view kUnicodeTextType = "VELKUI/UnicodeText";
constexpr std::string_view kClipboardRefusedKey =
    "$$$/velkui/ui/Error/ClipboardRefused=The clipboard could not be taken over.";
constexpr std::int32_t kClipboardRefusedNumber = 61;
constexpr auto kAnswerTimeout = std::chrono::milliseconds(1000);
constexpr std::size_t kLargestDirectTransfer = 256 * 1024;

std::u16string UTF16OfBytes(const std::string& bytes) {
  std::u16string text(bytes.size() / 2, u'\0');
  std::memcpy(text.data(), bytes.data(), text.size() * 2);
  // A terminating NUL is the desktop's habit, not part of the text.
  while (!text.empty() && text.back() == u'\0') text.pop_back();
  return text;
}

std::string BytesOfUTF16(const std::u16string& text) {
  std::string bytes(text.size() * 2, '\0');
  std::memcpy(bytes.data(), text.data(), bytes.size());
  return bytes;
}

std::string Latin1Of(const std::u16string& text) {
  std::string latin1;
  for (const char16_t c : text) latin1.push_back(c < 0x100 ? static_cast<char>(c) : '?');
  return latin1;
}

std::u16string UTF16OfLatin1(const std::string& latin1) {
  std::u16string text;
  for (const char c : latin1) text.push_back(static_cast<char16_t>(static_cast<unsigned char>(c)));
  return text;
}

}  // namespace

X11Clipboard::X11Clipboard(const X11Connection& connection)
    : connection_(connection), display_(connection.Get()) {
  XSetWindowAttributes attributes{};
  attributes.event_mask = PropertyChangeMask;
  window_ = XCreateWindow(display_, connection.Root(), -10, -10, 1, 1, 0, 0, InputOnly,
                          CopyFromParent, CWEventMask, &attributes);
}

X11Clipboard::~X11Clipboard() {
  HandOverToManager();
  XDestroyWindow(display_, window_);
}

void X11Clipboard::HandOverToManager() {
  // What we own would go with the process: a clipboard manager keeps a copy
  // (it asks for our targets while we wait for its answer).
  const Atom manager = connection_.Intern("CLIPBOARD_MANAGER");
  if (!Owns() || XGetSelectionOwner(display_, manager) == None) return;
  XConvertSelection(display_, manager, connection_.Intern("SAVE_TARGETS"), None, window_,
                    ServerTime());
  XFlush(display_);
  const auto deadline = std::chrono::steady_clock::now() + kAnswerTimeout;
  while (std::chrono::steady_clock::now() < deadline) {
    XEvent event;
    if (XCheckTypedWindowEvent(display_, window_, SelectionNotify, &event)) return;
    if (XCheckTypedEvent(display_, SelectionRequest, &event) ||
        XCheckTypedEvent(display_, PropertyNotify, &event)) {
      HandleEvent(event);
      continue;
    }
    pollfd descriptor{connection_.FileDescriptor(), POLLIN, 0};
    poll(&descriptor, 1, 20);
  }
}

bool X11Clipboard::Owns() {
  if (owned_ && XGetSelectionOwner(display_, connection_.Atoms().clipboard) != window_) {
    owned_ = false;
    items_.clear();
  }
  return owned_;
}

Time X11Clipboard::ServerTime() {
  // A zero-length append to a property of our own window brings back the
  // server's time in its PropertyNotify.
  XChangeProperty(display_, window_, connection_.Atoms().timestampProperty, XA_INTEGER, 32,
                  PropModeAppend, nullptr, 0);
  XEvent event;
  if (WaitFor(PropertyNotify, connection_.Atoms().timestampProperty, event)) {
    return event.xproperty.time;
  }
  return CurrentTime;
}

void X11Clipboard::Set(std::vector<ClipboardItem> items) {
  const Atom clipboard = connection_.Atoms().clipboard;
  if (items.empty()) {
    items_.clear();
    if (owned_) XSetSelectionOwner(display_, clipboard, None, ServerTime());
    owned_ = false;
    return;
  }
  const Time time = ServerTime();
  XSetSelectionOwner(display_, clipboard, window_, time);
  if (XGetSelectionOwner(display_, clipboard) != window_) {
    velkcore::ThrowError(velkcore::ErrorLevel::kError, kClipboardRefusedKey,
                         velkcore::kCategoryUserInterface, kClipboardRefusedNumber);
  }
  items_ = std::move(items);
  owned_ = true;
  ownedSince_ = time;
}

std::optional<std::string> X11Clipboard::Get(std::string_view type) {
  if (Owns()) {
    for (const ClipboardItem& item : items_) {
      if (item.type == type) return item.bytes;
    }
    return std::nullopt;
  }
  const X11Atoms& atoms = connection_.Atoms();
  if (type == kUnicodeTextType) {
    for (const Atom target : {atoms.utf8String, atoms.textPlainUtf8}) {
      if (std::optional<std::string> utf8 = Convert(target)) {
        return BytesOfUTF16(velkcore::UTF8to16(*utf8));
      }
    }
    if (std::optional<std::string> latin1 = Convert(XA_STRING)) {
      return BytesOfUTF16(UTF16OfLatin1(*latin1));
    }
    return std::nullopt;
  }
  return Convert(connection_.Intern(type));
}

std::vector<std::string> X11Clipboard::Types() {
  std::vector<std::string> types;
  if (Owns()) {
    for (const ClipboardItem& item : items_) types.push_back(item.type);
    return types;
  }
  const std::optional<std::string> list = Convert(connection_.Atoms().targets);
  if (!list) return types;
  const X11Atoms& atoms = connection_.Atoms();
  bool text = false;
  const std::size_t count = list->size() / sizeof(Atom);
  for (std::size_t i = 0; i < count; ++i) {
    Atom atom = None;
    std::memcpy(&atom, list->data() + i * sizeof(Atom), sizeof(Atom));
    if (atom == atoms.utf8String || atom == atoms.textPlainUtf8 || atom == XA_STRING ||
        atom == atoms.text || atom == atoms.textPlain) {
      text = true;
      continue;
    }
    std::string name = connection_.AtomName(atom);
    if (name.starts_with("VELKUI/") && name != kUnicodeTextType &&
        std::find(types.begin(), types.end(), name) == types.end()) {
      types.push_back(std::move(name));
    }
  }
  if (text) types.insert(types.begin(), std::string(kUnicodeTextType));
  return types;
}

// ---- Serving our items ----

bool X11Clipboard::HandleEvent(const XEvent& event) {
  switch (event.type) {
    case SelectionRequest:
      if (event.xselectionrequest.owner != window_) return false;
      Serve(event.xselectionrequest);
      return true;
    case SelectionClear:
      if (event.xselectionclear.window != window_) return false;
      if (event.xselectionclear.selection == connection_.Atoms().clipboard) {
        owned_ = false;
        items_.clear();
      }
      return true;
    case PropertyNotify: {
      if (event.xproperty.state != PropertyDelete) return event.xproperty.window == window_;
      const auto found = std::find_if(transfers_.begin(), transfers_.end(), [&](const Outgoing& t) {
        return t.requestor == event.xproperty.window && t.property == event.xproperty.atom;
      });
      if (found == transfers_.end()) return event.xproperty.window == window_;
      SendNextChunk(*found);
      if (found->offset > found->data.size()) transfers_.erase(found);
      return true;
    }
    default:
      return false;
  }
}

std::vector<Atom> X11Clipboard::OfferedTargets() const {
  const X11Atoms& atoms = connection_.Atoms();
  std::vector<Atom> targets{atoms.targets, atoms.timestamp};
  for (const ClipboardItem& item : items_) {
    if (item.type == kUnicodeTextType) {
      targets.insert(targets.end(), {atoms.utf8String, atoms.textPlainUtf8, XA_STRING, atoms.text,
                                     atoms.textPlain});
    }
    targets.push_back(connection_.Intern(item.type));
  }
  return targets;
}

std::optional<std::pair<Atom, std::string>> X11Clipboard::DataFor(Atom target) const {
  const X11Atoms& atoms = connection_.Atoms();
  const auto unicodeText = [this]() -> std::optional<std::u16string> {
    for (const ClipboardItem& item : items_) {
      if (item.type == kUnicodeTextType) return UTF16OfBytes(item.bytes);
    }
    return std::nullopt;
  };
  if (target == atoms.utf8String || target == atoms.textPlainUtf8 || target == atoms.text) {
    if (const std::optional<std::u16string> text = unicodeText()) {
      return std::pair{target == atoms.text ? atoms.utf8String : target, velkcore::UTF16to8(*text)};
    }
  }
  if (target == XA_STRING || target == atoms.textPlain) {
    if (const std::optional<std::u16string> text = unicodeText()) {
      return std::pair{target, Latin1Of(*text)};
    }
  }
  const std::string name = connection_.AtomName(target);
  for (const ClipboardItem& item : items_) {
    if (item.type == name) return std::pair{target, item.bytes};
  }
  return std::nullopt;
}

void X11Clipboard::Serve(const XSelectionRequestEvent& request) {
  const X11Atoms& atoms = connection_.Atoms();
  // Obsolete requestors name no property: the target stands in.
  const Atom property = request.property != None ? request.property : request.target;
  bool answered = false;
  if (owned_ && request.selection == atoms.clipboard) {
    if (request.target == atoms.targets) {
      const std::vector<Atom> targets = OfferedTargets();
      XChangeProperty(display_, request.requestor, property, XA_ATOM, 32, PropModeReplace,
                      reinterpret_cast<const unsigned char*>(targets.data()),
                      static_cast<int>(targets.size()));
      answered = true;
    } else if (request.target == atoms.timestamp) {
      const long time = static_cast<long>(ownedSince_);
      XChangeProperty(display_, request.requestor, property, XA_INTEGER, 32, PropModeReplace,
                      reinterpret_cast<const unsigned char*>(&time), 1);
      answered = true;
    } else if (std::optional<std::pair<Atom, std::string>> data = DataFor(request.target)) {
      if (data->second.size() <= kLargestDirectTransfer) {
        XChangeProperty(display_, request.requestor, property, data->first, 8, PropModeReplace,
                        reinterpret_cast<const unsigned char*>(data->second.data()),
                        static_cast<int>(data->second.size()));
      } else {
        // In increments: the requestor deletes the property for the next one.
        XSelectInput(display_, request.requestor, PropertyChangeMask);
        const long size = static_cast<long>(data->second.size());
        XChangeProperty(display_, request.requestor, property, atoms.incr, 32, PropModeReplace,
                        reinterpret_cast<const unsigned char*>(&size), 1);
        transfers_.push_back(
            {request.requestor, property, data->first, std::move(data->second), 0});
      }
      answered = true;
    }
  }
  XEvent reply{};
  reply.xselection.type = SelectionNotify;
  reply.xselection.display = display_;
  reply.xselection.requestor = request.requestor;
  reply.xselection.selection = request.selection;
  reply.xselection.target = request.target;
  reply.xselection.property = answered ? property : None;
  reply.xselection.time = request.time;
  XSendEvent(display_, request.requestor, False, NoEventMask, &reply);
  XFlush(display_);
}

void X11Clipboard::SendNextChunk(Outgoing& transfer) {
  const std::size_t size =
      std::min(kLargestDirectTransfer,
               transfer.data.size() - std::min(transfer.offset, transfer.data.size()));
  XChangeProperty(display_, transfer.requestor, transfer.property, transfer.type, 8,
                  PropModeReplace,
                  reinterpret_cast<const unsigned char*>(
                      transfer.data.data() + std::min(transfer.offset, transfer.data.size())),
                  static_cast<int>(size));
  // The empty chunk that ends the transfer moves the offset past the end.
  transfer.offset += size == 0 ? 1 : size;
  XFlush(display_);
}

// ---- Reading another owner's data ----

bool X11Clipboard::WaitFor(int type, Atom property, XEvent& event) {
  const auto deadline = std::chrono::steady_clock::now() + kAnswerTimeout;
  const auto matches = [&](const XEvent& e) {
    if (e.type != type) return false;
    if (type == SelectionNotify) return e.xselection.requestor == window_;
    return e.xproperty.window == window_ && e.xproperty.atom == property &&
           e.xproperty.state == PropertyNewValue;
  };
  XFlush(display_);
  for (;;) {
    // Other events stay queued for the message loop.
    const int queued = XEventsQueued(display_, QueuedAfterReading);
    for (int i = 0; i < queued; ++i) {
      if (XCheckTypedWindowEvent(display_, window_, type, &event)) {
        if (matches(event)) return true;
      }
    }
    const auto left = std::chrono::duration_cast<std::chrono::milliseconds>(
        deadline - std::chrono::steady_clock::now());
    if (left.count() <= 0) return false;
    pollfd descriptor{connection_.FileDescriptor(), POLLIN, 0};
    poll(&descriptor, 1, static_cast<int>(left.count()));
  }
}

std::optional<std::pair<Atom, std::string>> X11Clipboard::ReadProperty(Atom property, bool remove) {
  std::string bytes;
  Atom type = None;
  long offset = 0;
  for (;;) {
    int format = 0;
    unsigned long count = 0;
    unsigned long after = 0;
    unsigned char* data = nullptr;
    if (XGetWindowProperty(display_, window_, property, offset, 65536, False, AnyPropertyType,
                           &type, &format, &count, &after, &data) != Success) {
      return std::nullopt;
    }
    if (type == None) {
      if (data != nullptr) XFree(data);
      return std::nullopt;
    }
    // Format 32 comes as longs, whatever their size.
    const std::size_t unit = format == 32 ? sizeof(long) : static_cast<std::size_t>(format / 8);
    bytes.append(reinterpret_cast<const char*>(data), count * unit);
    offset += static_cast<long>(count * static_cast<unsigned long>(format) / 32);
    XFree(data);
    if (after == 0) break;
  }
  if (remove) XDeleteProperty(display_, window_, property);
  return std::pair{type, std::move(bytes)};
}

std::optional<std::string> X11Clipboard::Convert(Atom target) {
  const X11Atoms& atoms = connection_.Atoms();
  if (XGetSelectionOwner(display_, atoms.clipboard) == None) return std::nullopt;
  XDeleteProperty(display_, window_, atoms.selectionProperty);
  XConvertSelection(display_, atoms.clipboard, target, atoms.selectionProperty, window_,
                    ServerTime());
  XEvent event;
  if (!WaitFor(SelectionNotify, None, event) || event.xselection.property == None) {
    return std::nullopt;
  }
  // The owner's own property changes (the INCR announcement) came before its
  // answer: they must not pass for the first increment.
  XEvent stale;
  while (XCheckTypedWindowEvent(display_, window_, PropertyNotify, &stale)) {
  }
  std::optional<std::pair<Atom, std::string>> value = ReadProperty(atoms.selectionProperty, true);
  if (!value) return std::nullopt;
  if (value->first == atoms.incr) return ReadIncrementally();
  return std::move(value->second);
}

std::optional<std::string> X11Clipboard::ReadIncrementally() {
  const Atom property = connection_.Atoms().selectionProperty;
  std::string bytes;
  XFlush(display_);
  for (;;) {
    XEvent event;
    if (!WaitFor(PropertyNotify, property, event)) return std::nullopt;
    std::optional<std::pair<Atom, std::string>> chunk = ReadProperty(property, true);
    if (!chunk) return std::nullopt;
    XFlush(display_);
    if (chunk->second.empty()) return bytes;
    bytes += chunk->second;
  }
}

}  // namespace velkui::ui::x11
