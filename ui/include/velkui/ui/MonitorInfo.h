#pragma once

#include <cstdint>
#include <vector>

#include <velkcore/Geometry.h>
#include <velkcore/PropList.h>
#include <velkui/ui/PlatformTypes.h>

namespace velkui::ui {

// The monitors as rectangles in screen pixels, in the platform's enumeration
// order, and the placement questions windows ask about them.
class MonitorInfo {
 public:
  MonitorInfo();
  // Monitors given directly (their work areas are the whole monitors).
  explicit MonitorInfo(std::vector<velkcore::RectT<std::int32_t>> monitors);
  MonitorInfo(std::vector<velkcore::RectT<std::int32_t>> monitors,
              std::vector<velkcore::RectT<std::int32_t>> workAreas);
  virtual ~MonitorInfo();

  // ---- Virtual operations, in slot order ----
  // Whether enough of the rectangle's top (where a title bar is) lies on a
  // monitor's work area for the user to reach it: a piece at least 32 × 24
  // pixels (or the whole rectangle when it is smaller).
  virtual bool IsRectVisible(const velkcore::RectT<std::int32_t>& rect) const;
  // Moves (and, when it is larger, shrinks) `rect` into the work area of the
  // monitor it overlaps most (or lies nearest to) when it is not visible, or
  // always with `entirely`.
  virtual void EnsureRectIsVisible(velkcore::RectT<std::int32_t>* rect, bool entirely) const;
  // Reads the monitors again (nothing for monitors given directly).
  virtual void Update() const;

  std::int32_t GetMonitorCount() const { return static_cast<std::int32_t>(monitors_.size()); }
  // False (and `rect` untouched) for an index out of range.
  bool GetMonitorRect(std::int32_t index, velkcore::RectT<std::int32_t>& rect) const;
  bool GetWorkArea(std::int32_t index, velkcore::RectT<std::int32_t>& rect) const;
  // The monitor holding `point`; with `nearest`, else the one nearest to it
  // (without: an empty rectangle).
  velkcore::RectT<std::int32_t> GetMonitorRectFromPoint(const velkcore::PointT<std::int32_t>& point,
                                                        bool nearest) const;
  // The monitor the rectangle overlaps most, else the one nearest to its centre.
  velkcore::RectT<std::int32_t> GetMonitorRectFromRect(
      const velkcore::RectT<std::int32_t>& rect) const;
  // The right and bottom edges furthest out over all monitors.
  void GetMaxBottomRight(velkcore::PointT<std::int32_t>& point) const;
  // "NumMonitors" and, per monitor, "Monitor-<index>": a list of the four
  // integers left, top, width and height (keys "0" to "3").
  void SaveToPropList(velkcore::PropList& list) const;
  // Whether `list` (as SaveToPropList writes it) describes these monitors.
  bool Equals(const velkcore::PropList& list) const;

  // Reads a monitor list in that form; false when it is missing or not four integers.
  static bool ReadMonitorRect(const velkcore::PropList& list, std::int32_t index,
                              velkcore::RectT<std::int32_t>& rect);

 protected:
  std::int32_t FindMonitorIndexForRect(const velkcore::RectT<std::int32_t>& rect) const;

  mutable std::vector<velkcore::RectT<std::int32_t>> monitors_;
  mutable std::vector<velkcore::RectT<std::int32_t>> workAreas_;
};

// The monitors of the installed platform.
class OS_MonitorInfo : public MonitorInfo {
 public:
  // Reads the monitors at once (none without a platform).
  OS_MonitorInfo();
  void Update() const override;
  // The index of the monitor the rectangle overlaps most (-1 when none).
  std::int32_t GetMonitorIDFromRect(const velkcore::RectT<std::int32_t>& rect) const;
};

}  // namespace velkui::ui
