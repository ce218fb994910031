#include "companies/snapshot.h"

#include <gtest/gtest.h>

#include "base/runtime_error.h"
#include "tests/support/error_of.h"
#include "tests/support/failing_io.h"
#include "tests/support/mutate.h"
#include "tests/support/scripted_dialogs.h"
#include "tests/support/temp_home.h"

namespace kora::test {
namespace {

struct StandingClock : Clock {
  CalendarDate today{2026, 3, 4};
  CalendarDate Today() const override { return today; }
};

// A comms program that answers as the test says.
struct FakeComms : Processes {
  std::function<int()> run;
  std::string program;
  int RunAndWait(const std::string& path, const std::vector<std::string>&,
                 const std::function<void()>& idle) override {
    program = path;
    if (idle) idle();
    return run ? run() : 0;
  }
};

class SnapshotTest : public testing::Test {
 protected:
  SnapshotTest() {
    paths.SystemPath = "c:\\korawin\\";
    download.ServiceSystem = "c:\\dlsys\\";
    home.Put("drive_c/dlsys/x", "");
    home.Put("drive_c/korawin/Quickcomm.exe", "");
  }
  SnapshotServices Services() { return {home.files(), paths, download, dialogs, comms, clock}; }
  bool Fetch(std::vector<SnapshotRow>& rows) { return FetchSnapshot(Services(), 2, rows); }
  std::string Said() {
    std::string out;
    for (const auto& said : dialogs.said) out += "[" + said.title + "] " + said.text;
    dialogs.said.clear();
    return out;
  }
  static std::vector<SnapshotRow> Rows() {
    return {{.code = "BHP", .units = "100", .cost = "8", .dividend = "0.5"},
            {.code = "XAO", .kind = 'I'}};
  }

  FailingIo io;
  TempHome home{io};
  Paths paths;
  DownloadSettings download;
  ScriptedDialogs dialogs;
  FakeComms comms;
  StandingClock clock;
};

TEST_F(SnapshotTest, ListsComeBackAsTheyWereSaved) {
  SaveSnapshot(home.files(), paths.SystemPath, 1, Rows());
  EXPECT_EQ(home.Get("drive_c/korawin/Snapshot.Dat"), "BHP,S,100,8,0.5\r\nXAO,I,,,\r\n");
  const auto rows = ReadSnapshot(home.files(), paths.SystemPath, 1);
  ASSERT_EQ(rows.size(), 2u);
  EXPECT_EQ(rows[0].units + rows[0].cost + rows[0].dividend, "10080.5");
  EXPECT_EQ(rows[1].kind, 'I');
  EXPECT_TRUE(ReadSnapshot(home.files(), paths.SystemPath, 2).empty());
  EXPECT_EQ(ErrorOf([&] { SnapshotFile("c:\\", 4); }), kBadCall);
}

TEST_F(SnapshotTest, OddLinesOfAListAreTakenAsFarAsTheyGo) {
  std::string text = " bhp , i \n,S,1\n\nCBA\n";
  for (int i = 0; i < 20; ++i) text += "S" + std::to_string(i) + ",S\n";
  home.Put("drive_c/korawin/Snap3.Dat", text);
  const auto rows = ReadSnapshot(home.files(), paths.SystemPath, 3);
  ASSERT_EQ(rows.size(), kMostSnapshotRows);
  EXPECT_EQ(rows[0].code, "BHP");
  EXPECT_EQ(rows[0].kind, 'I');
  EXPECT_EQ(rows[1].code, "CBA");
}

TEST_F(SnapshotTest, AFetchWritesTheRequestAndReadsTheAnswer) {
  home.Put("drive_c/dlsys/Snap.Lst", "BHP,99\r\n");  // of an earlier one
  std::string request;
  comms.run = [&] {
    request = home.Get("drive_c/dlsys/Snap.Snd");
    EXPECT_FALSE(home.Exists("drive_c/dlsys/Snap.Lst"));
    EXPECT_TRUE(home.Exists("drive_c/dlsys/Comm.Stt"));
    home.Put("drive_c/dlsys/Snap.Lst",
             "XAO,3000,,,2990,,,10\r\nZZZ,1\r\nbhp,9.5,9.4,9.6,9.2,5000,12,0.3\r\n");
    return 0;
  };
  auto rows = Rows();
  EXPECT_TRUE(Fetch(rows));
  EXPECT_EQ(Said(), "");
  EXPECT_EQ(request, "S,BHP\r\nI,XAO\r\n");
  EXPECT_EQ(rows[0].prices,
            (std::array<std::string, 7>{"9.5", "9.4", "9.6", "9.2", "5000", "12", "0.3"}));
  EXPECT_EQ(rows[1].prices[0], "3000");
  EXPECT_TRUE(comms.program.ends_with("/drive_c/korawin/Quickcomm.exe"));
}

TEST_F(SnapshotTest, AccessesCountUntilMidnight) {
  comms.run = [&] {
    home.Put("drive_c/dlsys/Snap.Lst", "BHP,1\r\n");
    return 0;
  };
  auto rows = Rows();
  EXPECT_EQ(SnapshotAccesses(Services()), 0);
  Fetch(rows);
  Fetch(rows);
  EXPECT_EQ(SnapshotAccesses(Services()), 2);
  EXPECT_EQ(home.Get("drive_c/dlsys/Snap.Lct"), "2,2,20260304\r\n");
  clock.today = {2026, 3, 5};
  EXPECT_EQ(SnapshotAccesses(Services()), 0);
  home.Put("drive_c/dlsys/Snap.Lct", "rubbish\r\n");
  EXPECT_EQ(SnapshotAccesses(Services()), 0);
}

TEST_F(SnapshotTest, WithoutSecuritiesOrWithTooManyNothingIsAsked) {
  std::vector<SnapshotRow> none(1);
  EXPECT_FALSE(Fetch(none));
  EXPECT_EQ(Said(), "[Current Snapshot] Cannot proceed - no stocks listed");
  std::vector<SnapshotRow> many(16, SnapshotRow{.code = "BHP"});
  EXPECT_FALSE(Fetch(many));
  EXPECT_EQ(Said(), "[Current Snapshot] Maximum number of stocks for snapshot is 15");
  EXPECT_FALSE(home.Exists("drive_c/dlsys/Snap.Snd"));
}

TEST_F(SnapshotTest, AProgramThatIsNotThereIsNamed) {
  home.files().Remove("c:\\korawin\\Quickcomm.exe");
  auto rows = Rows();
  EXPECT_FALSE(Fetch(rows));
  EXPECT_EQ(Said(), "[Current Snapshot] File not found  c:\\korawin\\Quickcomm.exe");
  EXPECT_FALSE(home.Exists("drive_c/dlsys/Snap.Snd"));
}

TEST_F(SnapshotTest, FailuresOfTheProgramLeaveTheRowsAsTheyWere) {
  auto rows = Rows();
  rows[0].prices[0] = "7";
  comms.run = [] { return 3; };
  EXPECT_FALSE(Fetch(rows));
  EXPECT_EQ(Said(), "[Current Snapshot] No prices were received. Quickcomm.exe ended with error 3");
  comms.run = [&] {
    home.Put("drive_c/dlsys/Snap.Lst", "ZZZ,1\r\n\x01\x02\r\n");
    return 0;
  };
  EXPECT_FALSE(Fetch(rows));
  EXPECT_EQ(Said(), "[Current Snapshot] No prices were received");
  comms.run = [&] {
    home.Put("drive_c/dlsys/Snap.Lst", std::string((1u << 20) + 1, 'x'));
    return 0;
  };
  EXPECT_FALSE(Fetch(rows));
  EXPECT_NE(Said(), "");
  EXPECT_EQ(rows[0].prices[0], "7");
}

TEST_F(SnapshotTest, AHangingProgramCanBeGivenUp) {
  auto rows = Rows();
  EXPECT_FALSE(FetchSnapshot(Services(), 1, rows, [] { return false; }));
  EXPECT_EQ(Said(), "");
}

TEST_F(SnapshotTest, AFullDiskIsToldAndTheProgramNotStarted) {
  comms.run = [] {
    ADD_FAILURE();
    return 0;
  };
  auto rows = Rows();
  io.Reset(1);
  EXPECT_FALSE(Fetch(rows));
  io.Reset();
  EXPECT_NE(Said(), "");
}

TEST_F(SnapshotTest, AnswersOfOtherColumnsFillWhatTheyHave) {
  auto rows = Rows();
  EXPECT_EQ(UpdateGrid("BHP,1,2\r\nBHP\r\nXAO,1,2,3,4,5,6,7,8,9\r\n", rows), 2);
  EXPECT_EQ(rows[0].prices[0], "");  // the last line of a code holds
  EXPECT_EQ(rows[1].prices[6], "7");
  Mutator(3).Run({"BHP,1,2,3\r\nXAO,4,5\r\n", ""}, 300,
                 [&](const std::string& damaged) { EXPECT_LE(UpdateGrid(damaged, rows), 2); });
}

TEST_F(SnapshotTest, HoldingsAreWorthUnitsTimesPrice) {
  auto rows = Rows();
  rows[0].prices = {"9.5", "", "", "9", "", "", ""};
  const auto h = HoldingOf(rows[0]);
  ASSERT_TRUE(h);
  EXPECT_DOUBLE_EQ(h->value, 950);
  EXPECT_DOUBLE_EQ(h->previousValue, 900);
  EXPECT_DOUBLE_EQ(h->gain, 150);
  EXPECT_DOUBLE_EQ(h->dividends, 50);
  EXPECT_FALSE(HoldingOf(rows[1]));
  rows.push_back({.code = "CBA", .units = "10", .cost = "1"});
  rows[2].prices[0] = "2";
  EXPECT_DOUBLE_EQ(Totals(rows).value, 970);
  EXPECT_DOUBLE_EQ(Totals(rows).gain, 160);
  rows[2].prices[0] = "";  // before the first fetch nothing is lost
  EXPECT_DOUBLE_EQ(Totals(rows).gain, 150);
}

}  // namespace
}  // namespace kora::test
