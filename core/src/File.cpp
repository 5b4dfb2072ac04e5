#include <velkcore/File.h>

#include <fcntl.h>
#include <sys/stat.h>
#include <unistd.h>

#include <cerrno>
#include <system_error>

#include <velkcore/Error.h>

namespace fs = std::filesystem;

namespace velkcore {
namespace {

[[noreturn]] void RaiseFileError(std::string_view key, std::int32_t number, const fs::path& path,
                                 const std::error_code& reason) {
  ThrowError(ErrorLevel::kError, key, kCategoryUtilities, number, 0, path.string(),
             reason.message());
}

[[noreturn]] void RaiseErrno(std::string_view key, std::int32_t number, const fs::path& path,
                             int error) {
  RaiseFileError(key, number, path, std::error_code(error, std::generic_category()));
}

[[noreturn]] void RaiseWrongKind(const fs::path& path, bool isDirectory) {
  ThrowError(ErrorLevel::kError, kFileWrongKindKey, kCategoryUtilities, kFileWrongKindNumber, 0,
             path.string(), isDirectory ? "a directory" : "not a directory");
}

fs::path MakeFullPath(const fs::path& path) {
  RequireInput(!path.empty());
  std::error_code error;
  fs::path full = fs::absolute(path, error);
  if (error) RaiseFileError(kFileCannotAccessKey, kFileCannotAccessNumber, path, error);
  return full.lexically_normal();
}

// The type of what is at `path` (following links); not_found when nothing is.
fs::file_type TypeAt(const fs::path& path) {
  std::error_code error;
  const fs::file_status status = fs::status(path, error);
  if (status.type() == fs::file_type::not_found) return fs::file_type::not_found;
  if (error) RaiseFileError(kFileCannotAccessKey, kFileCannotAccessNumber, path, error);
  return status.type();
}

}  // namespace

// ---- FileByteStream ----

FileByteStream::FileByteStream(const fs::path& path) : path_(path) {
  do {
    descriptor_ = ::open(path.c_str(), O_RDONLY | O_CLOEXEC);
  } while (descriptor_ < 0 && errno == EINTR);
  if (descriptor_ < 0) RaiseErrno(kFileCannotOpenKey, kFileCannotOpenNumber, path, errno);
  struct stat info {};
  if (::fstat(descriptor_, &info) != 0 || S_ISDIR(info.st_mode)) {
    const int error = errno;
    const bool isDirectory = S_ISDIR(info.st_mode);
    ::close(descriptor_);
    if (isDirectory) RaiseWrongKind(path, true);
    RaiseErrno(kFileCannotOpenKey, kFileCannotOpenNumber, path, error);
  }
}

FileByteStream::~FileByteStream() {
  ::close(descriptor_);
}

std::uint64_t FileByteStream::Length() const {
  struct stat info {};
  if (::fstat(descriptor_, &info) != 0) {
    RaiseErrno(kFileCannotReadKey, kFileCannotReadNumber, path_, errno);
  }
  return static_cast<std::uint64_t>(info.st_size);
}

void FileByteStream::ReadBlock(std::uint64_t offset, void* buffer, std::size_t count) {
  RequireInput(buffer != nullptr || count == 0);
  const std::uint64_t length = Length();
  if (offset > length || count > length - offset) {
    ThrowError(ErrorLevel::kError, kFileReadOutOfRangeKey, kCategoryUtilities,
               kFileReadOutOfRangeNumber, 0, path_.string(), std::to_string(count),
               std::to_string(offset), std::to_string(length));
  }
  auto* out = static_cast<char*>(buffer);
  while (count > 0) {
    const ssize_t got = ::pread(descriptor_, out, count, static_cast<off_t>(offset));
    if (got < 0 && errno == EINTR) continue;
    if (got < 0) RaiseErrno(kFileCannotReadKey, kFileCannotReadNumber, path_, errno);
    // The file shrank between the length check and the read.
    if (got == 0) RaiseErrno(kFileCannotReadKey, kFileCannotReadNumber, path_, ENODATA);
    out += got;
    offset += static_cast<std::uint64_t>(got);
    count -= static_cast<std::size_t>(got);
  }
}

// ---- File ----

File::File(const fs::path& path) : path_(MakeFullPath(path)) {}

bool File::Exists() const {
  return TypeAt(path_) == fs::file_type::regular;
}

void File::Create() const {
  int descriptor = -1;
  do {
    descriptor = ::open(path_.c_str(), O_WRONLY | O_CREAT | O_CLOEXEC, 0666);
  } while (descriptor < 0 && errno == EINTR);
  if (descriptor < 0) {
    const int error = errno;
    if (error == EISDIR) RaiseWrongKind(path_, true);
    RaiseErrno(kFileCannotCreateKey, kFileCannotCreateNumber, path_, error);
  }
  ::close(descriptor);
}

bool File::Delete() const {
  std::error_code error;
  const fs::file_status status = fs::symlink_status(path_, error);
  if (status.type() == fs::file_type::not_found) return false;
  if (error) RaiseFileError(kFileCannotDeleteKey, kFileCannotDeleteNumber, path_, error);
  if (status.type() == fs::file_type::directory) RaiseWrongKind(path_, true);
  if (!fs::remove(path_, error) && error) {
    RaiseFileError(kFileCannotDeleteKey, kFileCannotDeleteNumber, path_, error);
  }
  return true;
}

std::unique_ptr<IPlatformByteStream> File::OpenForReading() const {
  return std::make_unique<FileByteStream>(path_);
}

// ---- Dir ----

Dir::Dir(const fs::path& path) : path_(MakeFullPath(path)) {}

bool Dir::Exists() const {
  return TypeAt(path_) == fs::file_type::directory;
}

void Dir::Create() const {
  std::error_code error;
  fs::create_directories(path_, error);
  if (error) RaiseFileError(kFileCannotCreateKey, kFileCannotCreateNumber, path_, error);
  if (!Exists()) RaiseWrongKind(path_, false);
}

bool Dir::Delete() const {
  std::error_code error;
  const fs::file_status status = fs::symlink_status(path_, error);
  if (status.type() == fs::file_type::not_found) return false;
  if (error) RaiseFileError(kFileCannotDeleteKey, kFileCannotDeleteNumber, path_, error);
  if (status.type() != fs::file_type::directory) RaiseWrongKind(path_, false);
  if (!fs::remove(path_, error) && error) {
    RaiseFileError(kFileCannotDeleteKey, kFileCannotDeleteNumber, path_, error);
  }
  return true;
}

// ---- free functions ----

bool FileExists(const fs::path& path) {
  return File(path).Exists();
}

bool RemoveFile(const fs::path& path) {
  return File(path).Delete();
}

std::string ReadFileContents(const fs::path& path) {
  FileByteStream stream(path);
  const std::uint64_t length = stream.Length();
  std::string content(static_cast<std::size_t>(length), '\0');
  stream.ReadBlock(0, content.data(), content.size());
  return content;
}

}  // namespace velkcore
