#pragma once

#include <cstdint>
#include <filesystem>
#include <map>
#include <memory>
#include <vector>

#include <velkcore/Geometry.h>
#include <velkcore/PropList.h>
#include <velkcore/Strings.h>

namespace velkui::ui {

// Where dialogs were: per dialog identifier the last frame, kept in one
// property-list file ("VELKDialogPrefs.xml" in the directory "VELKDialogPrefs"
// of a base directory) together with the monitors attached when it was written,
// so that frames can follow a changed monitor layout on the next start.
//
// The file:
//   "DialogInfo": per dialog, under its identifier in UTF-8, a list with
//     "DialogID" (the identifier) and "Position" (a rectangle record);
//   "MonitorInfo": "NumMonitors" and "Monitor-0", "Monitor-1", ... (see
//     MonitorInfo::SaveToPropList).
// A missing file is an empty store; so is a file that cannot be read. Stored
// monitors that make no sense (a bad count, a missing or short monitor list, a
// monitor of zero width or height) count as missing, which drops the stored
// frames, since they cannot be adjusted; an entry without a usable "Position"
// is skipped. The file is written atomically.
class PrefManager {
 public:
  // Creates the singleton over `baseDirectory`/VELKDialogPrefs (created when
  // missing; with `reset` emptied first) and loads the file. An installed
  // manager is finalized (saved) first.
  static void Initialize(const velkcore::UTF16String& baseDirectory, bool reset);
  // The singleton; null when there is none, or the input-contract violation
  // with `required`.
  static PrefManager* GetPrefManager(bool required = false);
  // Saves the file (an error is dropped) and destroys the singleton.
  static void Finalize();

  PrefManager(const PrefManager&) = delete;
  PrefManager& operator=(const PrefManager&) = delete;
  ~PrefManager();

  // False (and `rect` untouched) when the identifier has no entry.
  bool GetWindowPositionAndSize(const velkcore::UTF16String& id,
                                velkcore::RectT<std::int32_t>& rect) const;
  void SetWindowPositionAndSize(const velkcore::UTF16String& id,
                                const velkcore::RectT<std::int32_t>& rect);
  // Fills left and top only.
  bool GetWindowPosition(const velkcore::UTF16String& id,
                         velkcore::RectT<std::int32_t>& rect) const;
  // Keeps the caller's left and top; the width and height reach the stored
  // right and bottom edges.
  bool GetWindowSize(const velkcore::UTF16String& id, velkcore::RectT<std::int32_t>& rect) const;
  // Stores the left and top; a stored size survives (0 × 0 for a new entry).
  void SetWindowPosition(const velkcore::UTF16String& id,
                         const velkcore::RectT<std::int32_t>& rect);
  // Stores the width and height; a stored position survives ((0, 0) for a new entry).
  void SetWindowSize(const velkcore::UTF16String& id, const velkcore::RectT<std::int32_t>& rect);
  // Moves a frame stored under the stored monitors onto the current ones:
  // with as many monitors as before, each corner on a stored monitor whose
  // current twin (same index) differs is scaled with that monitor's size,
  // relative to its origin. With another count the frame stays as it is (its
  // user makes it visible with MonitorInfo::EnsureRectIsVisible).
  void AdjustForMonitorInfoChange(velkcore::RectT<std::int32_t>& rect) const;

  const std::filesystem::path& GetFilePath() const { return file_; }
  // Writes the file now (atomically), with the monitors attached now.
  void Save() const;

 private:
  explicit PrefManager(std::filesystem::path file);
  void Load();
  bool LoadStoredMonitors(const velkcore::PropList& monitorInfo);
  velkcore::PropList& EntryFor(const velkcore::UTF16String& id);
  bool ReadPosition(const velkcore::UTF16String& id, velkcore::RectT<std::int32_t>& rect) const;

  std::filesystem::path file_;
  std::map<velkcore::UTF16String, velkcore::PropList> dialogs_;
  std::vector<velkcore::RectT<std::int32_t>> storedMonitors_;
  std::int32_t storedMonitorCount_ = 0;
};

}  // namespace velkui::ui
