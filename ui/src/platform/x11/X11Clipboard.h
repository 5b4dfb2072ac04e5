#pragma once

#include "X11Headers.h"

#include <optional>
#include <string>
#include <string_view>
#include <vector>

#include <velkui/ui/PlatformTypes.h>

#include "X11Connection.h"

namespace velkui::ui::x11 {

// The CLIPBOARD selection. Setting it makes this process the owner, which
// serves each item under an X target named after its type, plus the usual
// text targets for "VELKUI/UnicodeText" (UTF-16 bytes of the host's order,
// converted to UTF-8). Reading asks the owner and waits (a bounded time) for
// its answer; large transfers go in increments both ways.
class X11Clipboard {
 public:
  explicit X11Clipboard(const X11Connection& connection);
  ~X11Clipboard();
  X11Clipboard(const X11Clipboard&) = delete;
  X11Clipboard& operator=(const X11Clipboard&) = delete;

  // Raises an error when the server gives the selection to someone else.
  void Set(std::vector<ClipboardItem> items);
  std::optional<std::string> Get(std::string_view type);
  std::vector<std::string> Types();

  // Takes the selection events and the property changes of transfers in
  // progress; false for any other event.
  bool HandleEvent(const XEvent& event);

 private:
  struct Outgoing {
    Window requestor = None;
    Atom property = None;
    Atom type = None;
    std::string data;
    std::size_t offset = 0;
  };

  // Asks the server: a SelectionClear not yet read must not leave old items.
  bool Owns();
  Time ServerTime();
  void HandOverToManager();
  void Serve(const XSelectionRequestEvent& request);
  std::optional<std::pair<Atom, std::string>> DataFor(Atom target) const;
  std::vector<Atom> OfferedTargets() const;
  void SendNextChunk(Outgoing& transfer);
  // Asks the owner for `target`; none when it refuses or does not answer in time.
  std::optional<std::string> Convert(Atom target);
  std::optional<std::string> ReadIncrementally();
  bool WaitFor(int type, Atom property, XEvent& event);
  std::optional<std::pair<Atom, std::string>> ReadProperty(Atom property, bool remove);

  const X11Connection& connection_;
  Display* display_;
  Window window_ = None;
  std::vector<ClipboardItem> items_;
  bool owned_ = false;
  Time ownedSince_ = CurrentTime;
  std::vector<Outgoing> transfers_;
};

}  // namespace velkui::ui::x11
