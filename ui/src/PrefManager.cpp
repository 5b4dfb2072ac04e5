#include <velkui/ui/PrefManager.h>

#include <optional>
#include <system_error>

#include <velkcore/Error.h>
#include <velkcore/File.h>
#include <velkcore/PropListXML.h>
#include <velkui/ui/MonitorInfo.h>

namespace velkui::ui {

using velkcore::PointT;
using velkcore::PropList;
using velkcore::RectT;

namespace {

constexpr const char* kDirectoryName = "VELKDialogPrefs";
constexpr const char* kFileName = "VELKDialogPrefs.xml";
constexpr const char* kDialogInfoKey = "DialogInfo";
constexpr const char* kDialogIDKey = "DialogID";
constexpr const char* kPositionKey = "Position";
constexpr const char* kMonitorInfoKey = "MonitorInfo";
constexpr const char* kNumMonitorsKey = "NumMonitors";
// More monitors than any desk holds: the count is damaged.
constexpr std::int32_t kMaxMonitors = 64;

constexpr std::string_view kCannotCreateDirectoryKey =
    "$$$/velkui/ui/Error/PrefDirectory=Unable to prepare the preferences directory '^0': ^1";
constexpr std::int32_t kCannotCreateDirectoryNumber = 24;

std::unique_ptr<PrefManager>& Instance() {
  static std::unique_ptr<PrefManager> instance;
  return instance;
}

bool ReadRect(const PropList& list, RectT<std::int32_t>& rect) {
  try {
    return velkcore::ReadRect32(list, kPositionKey, rect);
  } catch (const velkcore::Exception&) {
    return false;
  }
}

// The entry's "DialogID" (text in either form), else its key.
velkcore::UTF16String IdentifierOf(const PropList& entry, const std::string& key) {
  const std::optional<velkcore::PropType> type = entry.GetType(kDialogIDKey);
  velkcore::UTF16String id;
  if (type == velkcore::PropType::kUString && entry.Get(kDialogIDKey, id) && !id.empty()) {
    return id;
  }
  std::string utf8;
  if (type == velkcore::PropType::kString && entry.Get(kDialogIDKey, utf8) && !utf8.empty()) {
    return velkcore::UTF8to16(utf8);
  }
  return velkcore::UTF8to16(key);
}

// The stored monitor holding `p` (left <= x < right, top <= y < bottom), or -1.
std::int32_t FindMonitor(const std::vector<RectT<std::int32_t>>& monitors,
                         const PointT<std::int32_t>& p) {
  for (std::size_t i = 0; i < monitors.size(); ++i) {
    if (monitors[i].Contains(p)) return static_cast<std::int32_t>(i);
  }
  return -1;
}

}  // namespace

// ---- The singleton ----

void PrefManager::Initialize(const velkcore::UTF16String& baseDirectory, bool reset) {
  velkcore::RequireInput(!baseDirectory.empty());
  Finalize();
  const std::filesystem::path directory =
      std::filesystem::path(velkcore::UTF16to8(baseDirectory)) / kDirectoryName;
  std::error_code error;
  if (reset) std::filesystem::remove_all(directory, error);
  if (!error) std::filesystem::create_directories(directory, error);
  if (error) {
    velkcore::ThrowError(velkcore::ErrorLevel::kError, kCannotCreateDirectoryKey,
                         velkcore::kCategoryUserInterface, kCannotCreateDirectoryNumber, 0,
                         directory.string(), error.message());
  }
  std::unique_ptr<PrefManager> manager(new PrefManager(directory / kFileName));
  manager->Load();
  Instance() = std::move(manager);
}

PrefManager* PrefManager::GetPrefManager(bool required) {
  if (required) velkcore::RequireInput(Instance() != nullptr);
  return Instance().get();
}

void PrefManager::Finalize() {
  std::unique_ptr<PrefManager> manager = std::move(Instance());
  if (!manager) return;
  try {
    manager->Save();
  } catch (...) {
    // Losing remembered placements must not stop the program from ending.
  }
}

PrefManager::PrefManager(std::filesystem::path file) : file_(std::move(file)) {}

PrefManager::~PrefManager() = default;

// ---- Loading and saving ----

void PrefManager::Load() {
  PropList stored;
  try {
    stored = velkcore::LoadPropList(file_);
  } catch (const velkcore::Exception&) {
    // A damaged file is an empty store; the next save replaces it.
    return;
  }
  const PropList* monitorInfo = nullptr;
  const PropList* dialogInfo = nullptr;
  try {
    monitorInfo = stored.GetSubList(kMonitorInfoKey);
    dialogInfo = stored.GetSubList(kDialogInfoKey);
  } catch (const velkcore::Exception&) {
    return;
  }
  if (monitorInfo == nullptr || !LoadStoredMonitors(*monitorInfo)) return;
  if (dialogInfo == nullptr) return;
  for (const auto& [key, value] : *dialogInfo) {
    const PropList* entry = value.GetIf<PropList>();
    if (entry == nullptr) continue;
    RectT<std::int32_t> position;
    if (!ReadRect(*entry, position)) continue;
    const velkcore::UTF16String id = IdentifierOf(*entry, key);
    AdjustForMonitorInfoChange(position);
    PropList kept = *entry;
    kept.Set(kDialogIDKey, id);
    velkcore::WriteRect32(kept, kPositionKey, position);
    dialogs_[id] = std::move(kept);
  }
}

bool PrefManager::LoadStoredMonitors(const PropList& monitorInfo) {
  std::int32_t count = 0;
  try {
    if (!monitorInfo.Get(kNumMonitorsKey, count)) return false;
  } catch (const velkcore::Exception&) {
    return false;
  }
  if (count < 0 || count > kMaxMonitors) return false;
  std::vector<RectT<std::int32_t>> monitors;
  for (std::int32_t i = 0; i < count; ++i) {
    RectT<std::int32_t> monitor;
    if (!MonitorInfo::ReadMonitorRect(monitorInfo, i, monitor)) return false;
    // A monitor without area cannot scale anything.
    if (monitor.width <= 0 || monitor.height <= 0) return false;
    monitors.push_back(monitor);
  }
  storedMonitors_ = std::move(monitors);
  storedMonitorCount_ = count;
  return true;
}

void PrefManager::Save() const {
  PropList file;
  PropList* dialogInfo = file.NewSubList(kDialogInfoKey);
  for (const auto& [id, entry] : dialogs_) dialogInfo->Set(velkcore::UTF16to8(id), entry);
  PropList* monitorInfo = file.NewSubList(kMonitorInfoKey);
  const OS_MonitorInfo current;
  if (current.GetMonitorCount() > 0) {
    current.SaveToPropList(*monitorInfo);
  } else {
    // No platform to ask: the monitors as they were read.
    MonitorInfo(storedMonitors_).SaveToPropList(*monitorInfo);
  }
  velkcore::SavePropList(file, file_);
}

// ---- Entries ----

PropList& PrefManager::EntryFor(const velkcore::UTF16String& id) {
  PropList& entry = dialogs_[id];
  entry.Set(kDialogIDKey, id);
  return entry;
}

bool PrefManager::ReadPosition(const velkcore::UTF16String& id, RectT<std::int32_t>& rect) const {
  const auto found = dialogs_.find(id);
  return found != dialogs_.end() && ReadRect(found->second, rect);
}

bool PrefManager::GetWindowPositionAndSize(const velkcore::UTF16String& id,
                                           RectT<std::int32_t>& rect) const {
  return ReadPosition(id, rect);
}

void PrefManager::SetWindowPositionAndSize(const velkcore::UTF16String& id,
                                           const RectT<std::int32_t>& rect) {
  velkcore::WriteRect32(EntryFor(id), kPositionKey, rect);
}

bool PrefManager::GetWindowPosition(const velkcore::UTF16String& id,
                                    RectT<std::int32_t>& rect) const {
  RectT<std::int32_t> stored;
  if (!ReadPosition(id, stored)) return false;
  rect.left = stored.left;
  rect.top = stored.top;
  return true;
}

bool PrefManager::GetWindowSize(const velkcore::UTF16String& id, RectT<std::int32_t>& rect) const {
  RectT<std::int32_t> stored;
  if (!ReadPosition(id, stored)) return false;
  rect.width = stored.Right() - rect.left;
  rect.height = stored.Bottom() - rect.top;
  return true;
}

void PrefManager::SetWindowPosition(const velkcore::UTF16String& id,
                                    const RectT<std::int32_t>& rect) {
  RectT<std::int32_t> stored;
  if (!ReadPosition(id, stored)) stored = {};
  stored.left = rect.left;
  stored.top = rect.top;
  velkcore::WriteRect32(EntryFor(id), kPositionKey, stored);
}

void PrefManager::SetWindowSize(const velkcore::UTF16String& id, const RectT<std::int32_t>& rect) {
  RectT<std::int32_t> stored;
  if (!ReadPosition(id, stored)) stored = {};
  stored.width = rect.width;
  stored.height = rect.height;
  velkcore::WriteRect32(EntryFor(id), kPositionKey, stored);
}

// ---- Monitor changes ----

void PrefManager::AdjustForMonitorInfoChange(RectT<std::int32_t>& rect) const {
  const OS_MonitorInfo current;
  if (current.GetMonitorCount() != storedMonitorCount_ || storedMonitorCount_ == 0) return;
  PointT<std::int32_t> corners[4] = {{rect.left, rect.top},
                                     {rect.Right(), rect.top},
                                     {rect.Right(), rect.Bottom()},
                                     {rect.left, rect.Bottom()}};
  for (PointT<std::int32_t>& corner : corners) {
    const std::int32_t index = FindMonitor(storedMonitors_, corner);
    if (index < 0) continue;
    const RectT<std::int32_t>& was = storedMonitors_[static_cast<std::size_t>(index)];
    RectT<std::int32_t> now;
    if (!current.GetMonitorRect(index, now) || now == was) continue;
    const std::int64_t dx = corner.x - was.left;
    const std::int64_t dy = corner.y - was.top;
    corner.x = now.left + static_cast<std::int32_t>(dx * now.width / was.width);
    corner.y = now.top + static_cast<std::int32_t>(dy * now.height / was.height);
  }
  rect.left = corners[0].x;
  rect.top = corners[0].y;
  rect.width = std::max(corners[1].x, corners[2].x) - rect.left;
  rect.height = std::max(corners[2].y, corners[3].y) - rect.top;
}

}  // namespace velkui::ui
