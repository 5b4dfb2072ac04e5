#pragma once

// Questions both backends answer about the messages waiting in their queue,
// whatever a queue entry holds besides its event.

#include <algorithm>

#include <velkui/ui/OS_Event.h>
#include <velkui/ui/PlatformTypes.h>

namespace velkui::ui::platform {

inline const OS_Event& EventOf(const OS_Event& event) {
  return event;
}
template <typename Entry>
const OS_Event& EventOf(const Entry& entry) {
  return entry.event;
}

template <typename Queue>
bool HasPointerMoveFor(const Queue& queue, PlatformWindow window) {
  return std::any_of(queue.begin(), queue.end(), [window](const auto& entry) {
    const OS_Event& event = EventOf(entry);
    return event.GetWindow() == window && event.GetMsg() == kMsgPointerMove;
  });
}

// Takes the character message for `character` out of the queue when it is
// the first keyboard message waiting; true when it was.
template <typename Queue>
bool RemoveLeadingCharacter(Queue& queue, char16_t character) {
  const auto first = std::find_if(queue.begin(), queue.end(), [](const auto& entry) {
    return IsKeyboardMessage(EventOf(entry).GetMsg());
  });
  if (first == queue.end()) return false;
  const OS_Event& event = EventOf(*first);
  const bool isIt = (event.GetMsg() == kMsgChar || event.GetMsg() == kMsgSysChar) &&
                    event.GetWParam() == static_cast<std::uint64_t>(character);
  if (isIt) queue.erase(first);
  return isIt;
}

}  // namespace velkui::ui::platform
