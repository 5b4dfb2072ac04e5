#include <velkcore/File.h>
#include <velkcore/PropListXML.h>

#include <sys/resource.h>
#include <unistd.h>

#include <csignal>
#include <filesystem>
#include <fstream>
#include <functional>
#include <optional>
#include <string>

#include <gtest/gtest.h>

#include "CoreTestSupport.h"

using namespace velkcore;
using velkcore_test::ErrorOf;
using velkcore_test::Match;
using velkcore_test::Raises;
namespace fs = std::filesystem;

namespace {

void WriteText(const fs::path& path, const std::string& text) {
  std::ofstream(path, std::ios::binary) << text;
}

std::string ReadText(const fs::path& path) {
  std::ifstream in(path, std::ios::binary);
  return std::string(std::istreambuf_iterator<char>(in), {});
}

class FileTest : public testing::Test {
 protected:
  void SetUp() override {
    const auto* test = testing::UnitTest::GetInstance()->current_test_info();
    dir_ = fs::temp_directory_path() / ("velkcore-" + std::to_string(::getpid()) + "-" +
                                        test->test_suite_name() + "-" + test->name());
    fs::remove_all(dir_);
    fs::create_directories(dir_);
  }
  void TearDown() override { fs::remove_all(dir_); }

  std::size_t EntriesInDir() const {
    return static_cast<std::size_t>(std::distance(fs::directory_iterator(dir_), {}));
  }

  fs::path dir_;
};

PropList SampleList() {
  PropList list;
  list.Set("name", u"sample");
  list.Set("count", 3);
  list.NewSubList("sub")->Set("flag", true);
  return list;
}

}  // namespace

TEST_F(FileTest, FullPathIsAbsoluteAndNormal) {
  const fs::path cwd = fs::current_path();
  EXPECT_EQ(File("a/./b/../c.txt").FullPath(), cwd / "a" / "c.txt");
  EXPECT_EQ(Dir(dir_ / "x" / "..").FullPath(), dir_ / "");
  EXPECT_EQ(Dir(dir_).GetFile("f.txt").FullPath(), dir_ / "f.txt");
  EXPECT_THROW(File(""), Exception);
}

TEST_F(FileTest, FilesAreCreatedCheckedAndDeleted) {
  const File file(dir_ / "f.txt");
  EXPECT_FALSE(file.Exists());
  EXPECT_FALSE(FileExists(file.FullPath()));
  file.Create();
  EXPECT_TRUE(file.Exists());
  WriteText(file.FullPath(), "content");
  file.Create();
  EXPECT_EQ(ReadText(file.FullPath()), "content") << "Create keeps an existing file";
  EXPECT_TRUE(file.Delete());
  EXPECT_FALSE(file.Exists());
  EXPECT_FALSE(file.Delete());
  WriteText(dir_ / "g.txt", "x");
  EXPECT_TRUE(RemoveFile(dir_ / "g.txt"));
  EXPECT_FALSE(RemoveFile(dir_ / "g.txt"));
}

TEST_F(FileTest, FileFailuresNameThePath) {
  const fs::path inMissingDir = dir_ / "missing" / "f.txt";
  EXPECT_TRUE(
      Raises([&] { File(inMissingDir).Create(); }, kFileCannotCreateKey, inMissingDir.string()));

  fs::create_directory(dir_ / "sub");
  EXPECT_FALSE(FileExists(dir_ / "sub")) << "a directory is not a file";
  for (const auto& action : std::vector<std::function<void()>>{
           [&] { File(dir_ / "sub").Create(); }, [&] { RemoveFile(dir_ / "sub"); },
           [&] { FileByteStream stream(dir_ / "sub"); }}) {
    EXPECT_TRUE(Raises(action, kFileWrongKindKey,
                       "The path '" + (dir_ / "sub").string() + "' is a directory.",
                       Match::kWhole));
  }
  EXPECT_TRUE(fs::is_directory(dir_ / "sub"));
}

TEST_F(FileTest, DirectoriesAreCreatedCheckedAndDeleted) {
  const Dir nested(dir_ / "a" / "b");
  EXPECT_FALSE(nested.Exists());
  nested.Create();
  nested.Create();
  EXPECT_TRUE(nested.Exists());
  nested.GetFile("f").Create();
  EXPECT_TRUE(Raises([&] { nested.Delete(); }, kFileCannotDeleteKey));
  EXPECT_TRUE(nested.GetFile("f").Exists());
  nested.GetFile("f").Delete();
  EXPECT_TRUE(nested.Delete());
  EXPECT_FALSE(nested.Delete());

  WriteText(dir_ / "plain", "x");
  EXPECT_TRUE(ErrorOf([&] { Dir(dir_ / "plain").Create(); }));
  EXPECT_TRUE(Raises([&] { Dir(dir_ / "plain").Delete(); }, kFileWrongKindKey));
  EXPECT_EQ(ReadText(dir_ / "plain"), "x");
}

TEST_F(FileTest, ByteStreamReadsExactRanges) {
  WriteText(dir_ / "data", "0123456789");
  const auto stream = File(dir_ / "data").OpenForReading();
  EXPECT_EQ(stream->Length(), 10u);
  char buffer[10] = {};
  stream->ReadBlock(3, buffer, 4);
  EXPECT_EQ(std::string(buffer, 4), "3456");
  stream->ReadBlock(0, buffer, 10);
  EXPECT_EQ(std::string(buffer, 10), "0123456789");
  stream->ReadBlock(10, buffer, 0);

  std::fill(std::begin(buffer), std::end(buffer), 'x');
  for (const auto& range : std::vector<std::pair<std::uint64_t, std::size_t>>{
           {8, 3},
           {11, 0},
           {0, 11},
           {std::numeric_limits<std::uint64_t>::max(), 2},
           {2, std::numeric_limits<std::size_t>::max()}}) {
    EXPECT_TRUE(Raises([&] { stream->ReadBlock(range.first, buffer, range.second); },
                       kFileReadOutOfRangeKey))
        << range.first << "+" << range.second;
  }
  EXPECT_EQ(std::string(buffer, 10), std::string(10, 'x')) << "nothing is read";
  EXPECT_TRUE(Raises([&] { stream->ReadBlock(8, buffer, 3); }, kFileReadOutOfRangeKey,
                     "Cannot read 3 bytes at offset 8 of '" + (dir_ / "data").string() +
                         "', which holds 10 bytes.",
                     Match::kWhole));
  EXPECT_TRUE(Raises([&] { FileByteStream stream(dir_ / "none"); }, kFileCannotOpenKey,
                     (dir_ / "none").string()));
  EXPECT_EQ(ReadFileContents(dir_ / "data"), "0123456789");
}

TEST_F(FileTest, SaveAndLoadPropertyLists) {
  const fs::path path = dir_ / "prefs.xml";
  EXPECT_TRUE(LoadPropList(path).Empty()) << "a missing file is an empty list";
  SavePropList(SampleList(), path);
  EXPECT_EQ(LoadPropList(path), SampleList());
  EXPECT_EQ(ReadText(path), WritePropList(SampleList()));

  PropList changed = SampleList();
  changed.Set("count", 4);
  fs::permissions(path, fs::perms::owner_read | fs::perms::owner_write | fs::perms::group_read);
  SavePropList(changed, path);
  EXPECT_EQ(LoadPropList(path), changed);
  EXPECT_EQ(fs::status(path).permissions(),
            fs::perms::owner_read | fs::perms::owner_write | fs::perms::group_read);
  EXPECT_EQ(EntriesInDir(), 1u) << "no temporary file is left behind";

  // Through a link, the file it points to is replaced and the link stays.
  fs::create_symlink(path, dir_ / "link.xml");
  SavePropList(SampleList(), dir_ / "link.xml");
  EXPECT_TRUE(fs::is_symlink(dir_ / "link.xml"));
  EXPECT_EQ(LoadPropList(path), SampleList());
}

TEST_F(FileTest, LoadRaisesForUnreadableOrMalformedFiles) {
  WriteText(dir_ / "bad.xml", "<prop.map version='4'>\n<prop.list>\n<oops/>");
  const auto load = [&] { LoadPropList(dir_ / "bad.xml"); };
  EXPECT_TRUE(Raises(load, kPropListBadFileKey, (dir_ / "bad.xml").string()));
  EXPECT_TRUE(Raises(load, kPropListBadFileKey, "<oops> in a property list at line 3, column 1"));
  fs::create_directory(dir_ / "dir.xml");
  EXPECT_TRUE(Raises([&] { LoadPropList(dir_ / "dir.xml"); }, kPropListBadFileKey));
}

TEST_F(FileTest, AFailedSaveLeavesTheOldFileIntact) {
  const fs::path path = dir_ / "prefs.xml";
  SavePropList(SampleList(), path);
  const std::string before = ReadText(path);

  PropList big;
  big.Set("text", std::string(1 << 20, 'x'));
  // The size limit applies to root too; writes beyond it fail with EFBIG.
  rlimit old{};
  ASSERT_EQ(::getrlimit(RLIMIT_FSIZE, &old), 0);
  const auto oldHandler = std::signal(SIGXFSZ, SIG_IGN);
  rlimit small = old;
  small.rlim_cur = 4096;
  ASSERT_EQ(::setrlimit(RLIMIT_FSIZE, &small), 0);
  const ::testing::AssertionResult refused =
      Raises([&] { SavePropList(big, path); }, kPropListCannotSaveKey, path.string());
  ::setrlimit(RLIMIT_FSIZE, &old);
  std::signal(SIGXFSZ, oldHandler);

  EXPECT_TRUE(refused);
  EXPECT_EQ(ReadText(path), before);
  EXPECT_EQ(EntriesInDir(), 1u);

  // A list that cannot be written at all does not touch the file either.
  PropList deep;
  PropList* list = &deep;
  for (std::size_t i = 0; i < kMaxPropListDepth; ++i) list = list->NewSubList("k");
  EXPECT_THROW(SavePropList(deep, path), Exception);
  EXPECT_EQ(ReadText(path), before);

  // Neither does a rename that fails.
  fs::create_directories(dir_ / "target" / "occupied");
  EXPECT_THROW(SavePropList(SampleList(), dir_ / "target"), Exception);
  EXPECT_TRUE(fs::exists(dir_ / "target" / "occupied"));
  EXPECT_EQ(EntriesInDir(), 2u);

  EXPECT_TRUE(
      Raises([&] { SavePropList(SampleList(), dir_ / "no" / "f.xml"); }, kPropListCannotSaveKey));
}
