#include "base/host_files.h"

#include <gtest/gtest.h>

#include <filesystem>

#include "tests/support/error_of.h"
#include "tests/support/failing_io.h"
#include "tests/support/temp_home.h"

using namespace kora;
using namespace kora::test;

TEST(WriteHostFileTest, WritesWholeOrNotAtAll) {
  FailingIo io;
  TempHome home;
  home.Put("out.png", "old");
  int failures = 0;
  for (int at = 1; at < 100; ++at) {
    io.Reset(at);
    io.torn = true;
    const int error = ErrorOf([&] { WriteHostFile(io, home.path() + "/out.png", "new picture"); });
    if (io.calls < at) break;
    EXPECT_EQ(error, kDiskFull);
    EXPECT_EQ(home.Get("out.png"), "old");
    EXPECT_FALSE(home.Exists("out.png.tmp~"));
    ++failures;
  }
  EXPECT_EQ(failures, 7);
  EXPECT_EQ(home.Get("out.png"), "new picture");
}

TEST(WriteHostFileTest, KeepsALinkAndRefusesFoldersAndDevices) {
  TempHome home;
  home.Put("real.svg", "old");
  std::filesystem::create_symlink(home.path() + "/real.svg", home.path() + "/link.svg");
  WriteHostFile(MachineIo(), home.path() + "/link.svg", "new");
  EXPECT_TRUE(std::filesystem::is_symlink(home.path() + "/link.svg"));
  EXPECT_EQ(home.Get("real.svg"), "new");
  EXPECT_EQ(ErrorOf([&] { WriteHostFile(MachineIo(), home.path(), "x"); }), kPathAccess);
  EXPECT_EQ(ErrorOf([&] { WriteHostFile(MachineIo(), "/dev/null", "x"); }), kPathAccess);
  EXPECT_EQ(ErrorOf([&] { WriteHostFile(MachineIo(), home.path() + "/no/x", "x"); }),
            kPathNotFound);
}

TEST(ReadHostFileTest, RefusesWhatIsNoPlainFileAndWhatIsTooLarge) {
  TempHome home;
  home.Put("a.csv", "12345");
  const std::string path = home.path() + "/a.csv";
  EXPECT_EQ(ReadHostFile(MachineIo(), path, 5), "12345");
  EXPECT_EQ(ErrorOf([&] { ReadHostFile(MachineIo(), path, 4); }), kOutOfMemory);
  EXPECT_EQ(ErrorOf([&] { ReadHostFile(MachineIo(), home.path(), 9); }), kPathAccess);
  EXPECT_EQ(ErrorOf([&] { ReadHostFile(MachineIo(), "/dev/zero", 9); }), kPathAccess);
  EXPECT_EQ(ErrorOf([&] { ReadHostFile(MachineIo(), path + "x", 9); }), kFileNotFound);
}
