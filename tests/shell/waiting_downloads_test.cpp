#include "shell/waiting_downloads.h"

#include <gtest/gtest.h>

#include "base/runtime_error.h"
#include "tests/support/scripted_dialogs.h"
#include "tests/support/temp_home.h"

namespace kora {
namespace {

class Waiting : public testing::Test {
 protected:
  bool Ask(int service) {
    download.DataService = std::int16_t(service);
    dialogs.said.clear();
    return AskForWaitingDownloads(home.files(), download, dialogs);
  }
  void Put(const std::string& name) { home.Put("drive_c/in/" + name, "x"); }

  test::TempHome home;
  test::ScriptedDialogs dialogs;
  DownloadSettings download = [] {
    DownloadSettings d;
    d.DLPath = "c:\\in\\";
    return d;
  }();
};

TEST_F(Waiting, EachServiceHasItsQuestion) {
  Put("15SEP98.D");
  const std::pair<int, const char*> rows[] = {
      {1, " There are some KORA/Tarvo files to update into KORA"},
      {3, " There are some KORA/Tarvo files to update into KORA"},
      {2, " There are some BOURSE files to update into KORA"},
      {4, " There are some Ex Internet data files to update into KORA"},
      {5, " There are some EIS downloaded files to update into KORA"}};
  for (const auto& [service, text] : rows) {
    EXPECT_TRUE(Ask(service)) << service;
    ASSERT_EQ(dialogs.said.size(), 1u) << service;
    EXPECT_EQ(dialogs.said[0].text, text);
    EXPECT_EQ(dialogs.said[0].title, "Downloaded Data");
  }
}

TEST_F(Waiting, CancelPassesOn) {
  Put("15sep98.d");
  dialogs.answers = {Answer::kCancel};
  EXPECT_FALSE(Ask(4));
  EXPECT_EQ(dialogs.said.size(), 1u);
}

TEST_F(Waiting, NoWaitingFilesNoMessage) {
  Put("readme.txt");
  Put("15SEP98.DAS");
  Put(".d");
  for (const int service : {1, 2, 3, 4, 5}) {
    EXPECT_FALSE(Ask(service));
    EXPECT_TRUE(dialogs.said.empty());
  }
}

TEST_F(Waiting, WithoutAServiceNothingIsSearched) {
  Put("15SEP98.D");
  EXPECT_FALSE(Ask(0));
  EXPECT_TRUE(dialogs.said.empty());
}

TEST_F(Waiting, AMissingFolderIsPassedOver) {
  download.DLPath = "c:\\nowhere\\";
  EXPECT_FALSE(Ask(4));
  download.DLPath = "";
  EXPECT_FALSE(Ask(4));
  EXPECT_TRUE(dialogs.said.empty());
}

TEST_F(Waiting, AnotherFailureIsTold) {
  download.DLPath = "1:\\\\x\\";  // no path at all: error 52
  EXPECT_FALSE(Ask(4));
  ASSERT_EQ(dialogs.said.size(), 1u);
  EXPECT_EQ(dialogs.said[0].text,
            "Error while checking for KORATarvo download files not updated into KORA \n"
            "Check download paths and/or Modify Download Details ");
}

TEST_F(Waiting, InternetDataMayComeUnderItsOwnEnding) {
  Put("980915.ASX");
  EXPECT_FALSE(Ask(4));
  download.InternetDLfmt = "YYMMDD.ASX";
  EXPECT_TRUE(Ask(4));
  EXPECT_FALSE(Ask(2));
}

}  // namespace
}  // namespace kora
