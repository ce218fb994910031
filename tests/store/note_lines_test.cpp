#include <gtest/gtest.h>

#include "base/runtime_error.h"
#include "store/chart_notes.h"
#include "tests/support/error_of.h"
#include "tests/support/temp_home.h"

namespace kora {
namespace {

using test::ErrorOf;
using test::TempHome;

constexpr const char* kPath = "c:\\misc\\AAA.Txt";
constexpr const char* kHost = "drive_c/misc/AAA.Txt";

TEST(NoteLinesTest, ALineHoldsSixFieldsWithTheDateThePriceAndTheText) {
  const NoteLine note = MakeNoteLine("20260203", 12.5, "Bought here", 16777215);
  EXPECT_EQ(note.line, "T,8.25,20260203,12.50,Bought here,16777215");
  EXPECT_TRUE(note.readable);
  EXPECT_EQ(note.Date, "20260203");
  EXPECT_EQ(note.Price, 12.5);
  EXPECT_EQ(note.Text, "Bought here");
  EXPECT_EQ(note.Colour, 16777215);
}

TEST(NoteLinesTest, APriceBelowOneHasNoZeroBeforeThePoint) {
  EXPECT_EQ(MakeNoteLine("20260203", 0.354, "x", 1).line, "T,8.25,20260203,.35,x,1");
  EXPECT_EQ(MakeNoteLine("20260203", 0.354, "x", 1).Price, 0.35);
}

TEST(NoteLinesTest, WhatCannotBeReadIsKeptAsItStands) {
  TempHome home;
  const std::string text =
      "T,8.25,20260203,12.50,One,1\r\n"
      "nonsense\r\n"
      "\r\n"
      "T,8.25,20260203,twelve,Two,1\r\n"
      "T,8.25,20260203,12.50,a,b,1\r\n"
      "T,8.25,20260203,12.50," +
      std::string(100000, 'x') + ",1\r\nT,8.25,20260204,13.00,Last,1";
  home.Put(kHost, text);
  auto notes = ReadNoteLines(home.files(), kPath);
  ASSERT_EQ(notes.size(), 6u);
  EXPECT_TRUE(notes[0].readable);
  for (size_t i = 1; i < 5; ++i) EXPECT_FALSE(notes[i].readable) << i;
  EXPECT_EQ(notes[5].Text, "Last");
  AppendNoteLine(home.files(), kPath, MakeNoteLine("20260205", 1, "New", 2));
  EXPECT_EQ(home.Get(kHost), text + "\r\nT,8.25,20260205,1.00,New,2\r\n");
  notes.erase(notes.begin());
  WriteNoteLines(home.files(), kPath, notes);
  EXPECT_EQ(home.Get(kHost).substr(0, 10), "nonsense\r\n");
}

TEST(NoteLinesTest, NoFileIsNoNotes) {
  TempHome home;
  home.files().MakeFolder("c:\\misc");
  EXPECT_TRUE(ReadNoteLines(home.files(), kPath).empty());
  AppendNoteLine(home.files(), kPath, MakeNoteLine("20260205", 1, "New", 2));
  EXPECT_EQ(ReadNoteLines(home.files(), "c:\\misc\\aaa.TXT").size(), 1u);
  RemoveNotes(home.files(), kPath);
  RemoveNotes(home.files(), kPath);
  EXPECT_FALSE(home.Exists(kHost));
  home.files().MakeFolder(kPath);
  EXPECT_NE(ErrorOf([&] { ReadNoteLines(home.files(), kPath); }), 0);
  EXPECT_NE(ErrorOf([&] { AppendNoteLine(home.files(), kPath, MakeNoteLine("1", 1, "x", 1)); }), 0);
  EXPECT_EQ(ErrorOf([] { ChartNotesPath("c:\\misc\\", "A*"); }), kBadFileName);
}

TEST(NoteLinesTest, LettersBeyondAsciiAreAnsiInTheFile) {
  const NoteLine note = MakeNoteLine("20260203", 1, "caf\xC3\xA9", 1);
  EXPECT_EQ(note.line, "T,8.25,20260203,1.00,caf\xE9,1");
  EXPECT_EQ(note.Text, "caf\xC3\xA9");
}

}  // namespace
}  // namespace kora
