#pragma once

#include <cstddef>
#include <cstdint>
#include <filesystem>
#include <memory>
#include <string>
#include <string_view>

#include <velkcore/Error.h>

namespace velkcore {

// Every failure raises one of these (category 105), with the path in "^0"
// and the system's reason in "^1" unless the key says otherwise.
inline constexpr std::string_view kFileCannotAccessKey =
    "$$$/velkcore/File/Error/CannotAccess=Unable to access '^0': ^1";
inline constexpr std::string_view kFileCannotCreateKey =
    "$$$/velkcore/File/Error/CannotCreate=Unable to create '^0': ^1";
inline constexpr std::string_view kFileCannotDeleteKey =
    "$$$/velkcore/File/Error/CannotDelete=Unable to delete '^0': ^1";
inline constexpr std::string_view kFileCannotOpenKey =
    "$$$/velkcore/File/Error/CannotOpen=Unable to open '^0': ^1";
inline constexpr std::string_view kFileCannotReadKey =
    "$$$/velkcore/File/Error/CannotRead=Unable to read '^0': ^1";
// "^1" is "a directory" or "not a directory".
inline constexpr std::string_view kFileWrongKindKey =
    "$$$/velkcore/File/Error/WrongKind=The path '^0' is ^1.";
inline constexpr std::string_view kFileReadOutOfRangeKey =
    "$$$/velkcore/File/Error/ReadOutOfRange=Cannot read ^1 bytes at offset ^2 of '^0', which "
    "holds ^3 bytes.";

inline constexpr std::int32_t kFileCannotAccessNumber = 70;
inline constexpr std::int32_t kFileCannotCreateNumber = 71;
inline constexpr std::int32_t kFileCannotDeleteNumber = 72;
inline constexpr std::int32_t kFileCannotOpenNumber = 73;
inline constexpr std::int32_t kFileCannotReadNumber = 74;
inline constexpr std::int32_t kFileWrongKindNumber = 75;
inline constexpr std::int32_t kFileReadOutOfRangeNumber = 76;

// Random access to the bytes of a file or another source.
class IPlatformByteStream {
 public:
  virtual ~IPlatformByteStream() = default;

  virtual std::uint64_t Length() const = 0;
  // Copies exactly `count` bytes starting at `offset` into `buffer`. A range
  // that does not lie wholly within the stream raises kFileReadOutOfRangeKey
  // and reads nothing; there are no short reads.
  virtual void ReadBlock(std::uint64_t offset, void* buffer, std::size_t count) = 0;
};

// A byte stream over an open file. Length follows the file as it is now.
class FileByteStream final : public IPlatformByteStream {
 public:
  // Raises kFileCannotOpenKey, or kFileWrongKindKey for a directory.
  explicit FileByteStream(const std::filesystem::path& path);
  FileByteStream(const FileByteStream&) = delete;
  FileByteStream& operator=(const FileByteStream&) = delete;
  ~FileByteStream() override;

  std::uint64_t Length() const override;
  void ReadBlock(std::uint64_t offset, void* buffer, std::size_t count) override;

 private:
  std::filesystem::path path_;
  int descriptor_ = -1;
};

// A file path. The path is made absolute (against the current directory at
// construction) and normalised; an empty path is an input-contract violation.
class File {
 public:
  explicit File(const std::filesystem::path& path);

  const std::filesystem::path& FullPath() const { return path_; }
  // Whether a regular file (or a link to one) is there.
  bool Exists() const;
  // Creates an empty file; an existing file is left as it is.
  void Create() const;
  // Removes the file: true when it was removed, false when there was none.
  bool Delete() const;
  std::unique_ptr<IPlatformByteStream> OpenForReading() const;

 private:
  std::filesystem::path path_;
};

// A directory path, made absolute and normalised like File's.
class Dir {
 public:
  explicit Dir(const std::filesystem::path& path);

  const std::filesystem::path& FullPath() const { return path_; }
  bool Exists() const;
  // Creates the directory and any missing parents; an existing one is fine.
  void Create() const;
  // Removes the directory, which must be empty: true when it was removed,
  // false when there was none.
  bool Delete() const;

  File GetFile(const std::filesystem::path& name) const { return File(path_ / name); }
  Dir GetSubDir(const std::filesystem::path& name) const { return Dir(path_ / name); }

 private:
  std::filesystem::path path_;
};

bool FileExists(const std::filesystem::path& path);
// True when the file was removed, false when there was none.
bool RemoveFile(const std::filesystem::path& path);
// The whole content of a file.
std::string ReadFileContents(const std::filesystem::path& path);

}  // namespace velkcore
