#include <velkcore/File.h>
#include <velkcore/PropListXML.h>

#include <fcntl.h>
#include <sys/stat.h>
#include <unistd.h>

#include <atomic>
#include <cerrno>
#include <chrono>
#include <cstring>
#include <system_error>

#include <velkcore/Error.h>

namespace fs = std::filesystem;

namespace velkcore {
namespace {

[[noreturn]] void RaiseCannotSave(const fs::path& path, int error) {
  ThrowError(ErrorLevel::kError, kPropListCannotSaveKey, kCategoryUtilities,
             kPropListCannotSaveNumber, 0, path.string(),
             std::error_code(error, std::generic_category()).message());
}

// Saving through a link replaces the file it points to, not the link.
fs::path ResolveLink(const fs::path& path) {
  std::error_code error;
  if (!fs::is_symlink(fs::symlink_status(path, error))) return path;
  const fs::path target = fs::weakly_canonical(path, error);
  return error ? path : target;
}

// A file next to the target, removed again unless Commit renames it into place.
class TemporaryFile {
 public:
  explicit TemporaryFile(const fs::path& target) : target_(target) {
    static std::atomic<unsigned> counter{0};
    const auto stamp = std::chrono::steady_clock::now().time_since_epoch().count();
    int error = 0;
    for (int attempt = 0; attempt < 100 && descriptor_ < 0; ++attempt) {
      path_ = target;
      path_.replace_filename("." + target.filename().string() + "." + std::to_string(::getpid()) +
                             "." + std::to_string(stamp) + "." + std::to_string(counter++) +
                             ".tmp");
      descriptor_ = ::open(path_.c_str(), O_WRONLY | O_CREAT | O_EXCL | O_CLOEXEC, 0666);
      error = descriptor_ < 0 ? errno : 0;
      if (error != 0 && error != EEXIST && error != EINTR) break;
    }
    if (descriptor_ < 0) RaiseCannotSave(target_, error);
  }

  TemporaryFile(const TemporaryFile&) = delete;
  TemporaryFile& operator=(const TemporaryFile&) = delete;

  ~TemporaryFile() {
    if (descriptor_ >= 0) ::close(descriptor_);
    if (!committed_) ::unlink(path_.c_str());
  }

  void Write(std::string_view bytes) {
    while (!bytes.empty()) {
      const ssize_t written = ::write(descriptor_, bytes.data(), bytes.size());
      if (written < 0 && errno == EINTR) continue;
      if (written < 0) RaiseCannotSave(target_, errno);
      bytes.remove_prefix(static_cast<std::size_t>(written));
    }
  }

  // The new file keeps the permissions of the one it replaces.
  void CopyModeOfTarget() {
    struct stat info {};
    if (::stat(target_.c_str(), &info) == 0 && ::fchmod(descriptor_, info.st_mode & 07777) != 0) {
      RaiseCannotSave(target_, errno);
    }
  }

  void Commit() {
    if (::fsync(descriptor_) != 0) RaiseCannotSave(target_, errno);
    const int closed = ::close(descriptor_);
    descriptor_ = -1;
    if (closed != 0) RaiseCannotSave(target_, errno);
    if (::rename(path_.c_str(), target_.c_str()) != 0) RaiseCannotSave(target_, errno);
    committed_ = true;
    SyncDirectory();
  }

 private:
  // Makes the rename itself durable. The new content is already in place, so
  // a file system that cannot sync directories is no reason to fail the save.
  void SyncDirectory() const {
    const int directory = ::open(target_.parent_path().c_str(), O_RDONLY | O_DIRECTORY | O_CLOEXEC);
    if (directory < 0) return;
    ::fsync(directory);
    ::close(directory);
  }

  fs::path target_;
  fs::path path_;
  int descriptor_ = -1;
  bool committed_ = false;
};

}  // namespace

void SavePropList(const PropList& list, const fs::path& path) {
  const fs::path target = ResolveLink(File(path).FullPath());
  const std::string text = WritePropList(list);
  TemporaryFile file(target);
  file.Write(text);
  file.CopyModeOfTarget();
  file.Commit();
}

PropList LoadPropList(const fs::path& path) {
  const File file(path);
  try {
    std::error_code error;
    if (fs::status(file.FullPath(), error).type() == fs::file_type::not_found) return {};
    return ReadPropList(ReadFileContents(file.FullPath()));
  } catch (const Exception& e) {
    ThrowError(ErrorLevel::kError, kPropListBadFileKey, kCategoryUtilities, kPropListBadFileNumber,
               0, file.FullPath().string(), e.what());
  }
}

}  // namespace velkcore
