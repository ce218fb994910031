#include "platform/settings_file.h"

#include <gtest/gtest.h>

#include <filesystem>

#include "tests/support/counting_io.h"
#include "tests/support/failing_io.h"
#include "tests/support/temp_home.h"

using namespace kora;
using kora::test::CountingIo;
using kora::test::FailingIo;
using kora::test::TempHome;

namespace {

const std::string kPath = "C:\\WINDOWS\\Kora.ini";

// A home with a settings file in it.
struct Ini {
  explicit Ini(std::string_view text = {}, Io& io = MachineIo())
      : home(io), file(home.files(), kPath) {
    if (!text.empty()) home.Put("Kora.ini", text);
  }
  std::string Get(std::string_view section, std::string_view key) const {
    return file.GetSetting(section, key);
  }
  std::string text() const { return home.Get("Kora.ini"); }

  TempHome home;
  SettingsFile file;
};

}  // namespace

// ---- reading

TEST(SettingsFileTest, MissingOrEmptyIsUnknown) {
  Ini ini("[Charts]\r\nType=\r\nPeriod=   \r\nSpacing=4\r\n");
  EXPECT_EQ(ini.Get("Charts", "Spacing"), "4");
  EXPECT_EQ(ini.Get("Charts", "Type"), "unknown");
  EXPECT_EQ(ini.Get("Charts", "Period"), "unknown");
  EXPECT_EQ(ini.Get("Charts", "Bands"), "unknown");
  EXPECT_EQ(ini.Get("Download", "Spacing"), "unknown");
  EXPECT_EQ(ini.Get("", ""), "unknown");
  EXPECT_EQ(Ini().Get("Charts", "Spacing"), "unknown");
  EXPECT_FALSE(Ini().file.Exists());
  EXPECT_TRUE(ini.file.Exists());
}

TEST(SettingsFileTest, ValueIsTrimmedAndCutAtSixtyCharacters) {
  const std::string sixty(60, 'x');
  Ini ini("[s]\na=  two words \nb=" + sixty + "y\nc=" + sixty + "\nd=" + std::string(59, 'x') +
          " z\ne=" + std::string(59, 'x') + "\xE9\xE9\nf=a=b=c\n");
  EXPECT_EQ(ini.Get("s", "a"), "two words");
  EXPECT_EQ(ini.Get("s", "b"), sixty);
  EXPECT_EQ(ini.Get("s", "c"), sixty);
  EXPECT_EQ(ini.Get("s", "d"), std::string(59, 'x'));             // cut behind a blank
  EXPECT_EQ(ini.Get("s", "e"), std::string(59, 'x') + "\u00E9");  // a whole character
  EXPECT_EQ(ini.Get("s", "f"), "a=b=c");
}

TEST(SettingsFileTest, SectionsAndKeysMatchInAnyCase) {
  Ini ini(" [ Chart Fonts ] \r\n  SFont Size = 9 \r\n");
  EXPECT_EQ(ini.Get("CHART FONTS", "sfont size"), "9");
  EXPECT_EQ(ini.Get(" chart fonts ", " SFONT SIZE "), "9");
}

TEST(SettingsFileTest, FirstOfTwoKeysWinsAlsoAcrossASectionThatComesTwice) {
  Ini ini("[s]\nk=1\nK=2\n[t]\nx=1\n[S]\nk=3\nm=4\n");
  EXPECT_EQ(ini.Get("s", "k"), "1");
  EXPECT_EQ(ini.Get("s", "m"), "4");
  EXPECT_TRUE(ini.file.PutSetting("s", "k", "9"));
  EXPECT_EQ(ini.text(), "[s]\r\nk=9\r\nK=2\r\n[t]\r\nx=1\r\n[S]\r\nk=3\r\nm=4\r\n");
}

TEST(SettingsFileTest, KeyBeforeAnySectionIsInNone) {
  Ini ini("stray=1\n[s]\nk=2\n");
  EXPECT_EQ(ini.Get("s", "stray"), "unknown");
  EXPECT_EQ(ini.Get("s", "k"), "2");
}

TEST(SettingsFileTest, CommentIsNoKey) {
  Ini ini("[s]\n;k=1\nk=2\n");
  EXPECT_EQ(ini.Get("s", "k"), "2");
  EXPECT_EQ(ini.Get("s", ";k"), "unknown");
}

TEST(SettingsFileTest, AnsiOutsideUtf8Inside) {
  Ini ini("[Pfade]\r\nSch\xF6n=\x80 5\r\n");
  EXPECT_EQ(ini.Get("Pfade", "Sch\u00F6n"), "\u20AC 5");
  EXPECT_TRUE(ini.file.PutSetting("Pfade", "Sch\u00F6n", "\u00FC"));
  EXPECT_EQ(ini.text(), "[Pfade]\r\nSch\xF6n=\xFC\r\n");
}

// ---- writing

TEST(SettingsFileTest, FirstWriteMakesTheFile) {
  Ini ini;
  EXPECT_TRUE(ini.file.PutSetting("Charts", "Type", " B "));
  EXPECT_EQ(ini.text(), "[Charts]\r\nType=B\r\n");
  EXPECT_EQ(ini.Get("charts", "type"), "B");
}

TEST(SettingsFileTest, WritesInPlaceAtTheSectionsEndOrInANewSection) {
  Ini ini("[a]\r\nk=1\r\n\r\n[b]\r\nx=1\r\n");
  EXPECT_TRUE(ini.file.PutSetting("a", "k", "2"));
  EXPECT_TRUE(ini.file.PutSetting("a", "m", "3"));
  EXPECT_TRUE(ini.file.PutSetting("b", "y", "4"));
  EXPECT_TRUE(ini.file.PutSetting("c", "z", "5"));
  EXPECT_EQ(ini.text(), "[a]\r\nk=2\r\nm=3\r\n\r\n[b]\r\nx=1\r\ny=4\r\n\r\n[c]\r\nz=5\r\n");
}

TEST(SettingsFileTest, ForeignLinesAndCommentsStayByteForByte) {
  using namespace std::string_literals;
  const std::string odd =
      "; a comment\r\n\r\nrubbish \x81\x8D\x90\xFF\r\n[x\r\n  [s] tail\r\n\tk = old\r\n"
      "a\0b=1\r\n=nothing\r\n"s;
  Ini ini(odd);
  EXPECT_TRUE(ini.file.PutSetting("s", "new", "1"));
  EXPECT_EQ(ini.text(), odd + "new=1\r\n");
}

TEST(SettingsFileTest, LineEndsInAValueInjectNothing) {
  Ini ini("[s]\r\nsafe=1\r\n");
  EXPECT_TRUE(ini.file.PutSetting("s", "k", "a\r\n[t]\r\nsafe=2\nx"));
  EXPECT_EQ(ini.text(), "[s]\r\nsafe=1\r\nk=a  [t]  safe=2 x\r\n");
  EXPECT_EQ(ini.Get("s", "safe"), "1");
  EXPECT_EQ(ini.Get("t", "safe"), "unknown");
  EXPECT_TRUE(ini.file.PutSetting("s", "k", std::string_view("a\0b", 3)));
  EXPECT_EQ(ini.Get("s", "k"), "a b");
}

TEST(SettingsFileTest, NamesThatWouldNotReadBackAreRefused) {
  Ini ini("[s]\r\nsafe=1\r\n");
  const std::string before = ini.text();
  for (const char* key :
       {"", "  ", "a=b", "=", "safe=2\r\nx", "a\nb", "a\rb", ";k", "[k", "[k]", " ;k"})
    EXPECT_FALSE(ini.file.PutSetting("s", key, "v")) << key;
  for (const char* section : {"", " ", "a]b", "]", "a\nb", "a]\r\n[s"})
    EXPECT_FALSE(ini.file.PutSetting(section, "k", "v")) << section;
  EXPECT_FALSE(ini.file.PutSetting("s", std::string_view("a\0b", 3), "v"));
  EXPECT_EQ(ini.text(), before);
  EXPECT_TRUE(ini.file.PutSetting("[odd", "k]; x", "v"));
  EXPECT_EQ(ini.Get("[odd", "k]; x"), "v");
}

TEST(SettingsFileTest, SameValueWritesNothing) {
  CountingIo io;
  Ini ini("[s]\r\nk=1\r\n", io);
  EXPECT_TRUE(ini.file.PutSetting("s", "k", " 1 "));
  EXPECT_EQ(io.renames, 0);
}

TEST(SettingsFileTest, OverrideIsReadButNeverWritten) {
  Ini ini("[s]\r\nk=file\r\n");
  ini.file.Override("S", "K", " run ");
  ini.file.Override("s", "only", "1");
  EXPECT_EQ(ini.Get("s", "k"), "run");
  EXPECT_EQ(ini.Get("s", "only"), "1");
  EXPECT_TRUE(ini.file.PutSetting("s", "k", "run"));
  EXPECT_TRUE(ini.file.PutSetting("s", "only", "1"));
  EXPECT_EQ(ini.text(), "[s]\r\nk=file\r\n") << "as a save of everything puts them back";
  ini.file.Override("s", "folder", "c:\\a");
  EXPECT_TRUE(ini.file.PutSetting("s", "folder", "C:\\A\\"));
  EXPECT_EQ(ini.text(), "[s]\r\nk=file\r\n");
  EXPECT_TRUE(ini.file.PutSetting("s", "k", "kept"));
  EXPECT_TRUE(ini.file.PutSetting("s", "other", "2"));
  EXPECT_EQ(ini.text(), "[s]\r\nk=kept\r\nother=2\r\n");
  EXPECT_EQ(ini.Get("s", "k"), "run");
  EXPECT_EQ(SettingsFile(ini.home.files(), kPath).GetSetting("s", "k"), "kept");
}

TEST(SettingsFileTest, BatchReplacesTheFileOnce) {
  CountingIo io;
  Ini ini("[s]\r\nk=1\r\n", io);
  {
    SettingsFile::Batch batch(ini.file);
    for (int i = 0; i < 50; ++i)
      EXPECT_TRUE(ini.file.PutSetting("s", "k" + std::to_string(i), std::to_string(i)));
    {
      SettingsFile::Batch inner(ini.file);
      EXPECT_TRUE(ini.file.PutSetting("t", "x", "y"));
    }
    EXPECT_EQ(ini.text(), "[s]\r\nk=1\r\n");
    EXPECT_EQ(ini.Get("s", "k49"), "49");
  }
  EXPECT_EQ(io.renames, 1);
  EXPECT_EQ(ini.Get("s", "k"), "1");
  EXPECT_EQ(ini.Get("s", "k0"), "0");
  EXPECT_EQ(ini.Get("t", "x"), "y");
  { SettingsFile::Batch nothing(ini.file); }
  EXPECT_EQ(io.renames, 1);
}

// ---- when things go wrong

TEST(SettingsFileTest, FailingWriteLeavesFileAndValuesAsTheyWere) {
  for (int at = 1; at <= 7; ++at) {
    FailingIo io;
    Ini ini("[s]\r\nk=1\r\n", io);
    EXPECT_EQ(ini.Get("s", "k"), "1");
    io.Reset(at);
    EXPECT_FALSE(ini.file.PutSetting("s", "k", "2")) << at;
    EXPECT_EQ(ini.text(), "[s]\r\nk=1\r\n");
    EXPECT_EQ(ini.Get("s", "k"), "1");
    io.Reset(at);
    {
      SettingsFile::Batch batch(ini.file);
      ini.file.PutSetting("s", "k", "3");
      ini.file.PutSetting("t", "m", "4");
    }
    EXPECT_EQ(ini.text(), "[s]\r\nk=1\r\n");
    EXPECT_EQ(ini.Get("s", "k"), "1");
    EXPECT_EQ(ini.Get("t", "m"), "unknown");
    io.Reset();
    EXPECT_TRUE(ini.file.PutSetting("s", "k", "5"));
    EXPECT_EQ(ini.text(), "[s]\r\nk=5\r\n");
  }
}

TEST(SettingsFileTest, ChangeByAnotherProcessIsSeenAndKept) {
  Ini ini("[s]\r\nk=1\r\nm=1\r\n");
  EXPECT_EQ(ini.Get("s", "k"), "1");
  SettingsFile other(ini.home.files(), kPath);
  EXPECT_TRUE(other.PutSetting("s", "k", "2"));  // the same size, perhaps the same tick
  EXPECT_EQ(ini.Get("s", "k"), "2");
  EXPECT_TRUE(other.PutSetting("s", "k", "3"));
  {
    SettingsFile::Batch batch(ini.file);
    EXPECT_TRUE(ini.file.PutSetting("s", "m", "9"));
  }
  EXPECT_EQ(ini.text(), "[s]\r\nk=3\r\nm=9\r\n");
  std::filesystem::remove(ini.home.path() + "/Kora.ini");
  EXPECT_EQ(ini.Get("s", "k"), "unknown");
}

TEST(SettingsFileTest, AValueThatWouldNotReadBackIsRefusedAndTheOldOneStays) {
  Ini ini("[s]\r\nk=old\r\n");
  EXPECT_FALSE(ini.file.PutSetting("s", "k", "c:\\\u4E2D\\"));  // no character of Windows-1252
  EXPECT_FALSE(ini.file.PutSetting("s", "k", std::string(61, 'x')));
  EXPECT_FALSE(ini.file.PutSetting("s", "new", "\u03A9"));
  EXPECT_EQ(ini.text(), "[s]\r\nk=old\r\n");
  EXPECT_TRUE(ini.file.PutSetting("s", "k", std::string(60, 'x')));
  EXPECT_TRUE(ini.file.PutSetting("s", "k", "  caf\u00E9 \u20AC? "));
  EXPECT_EQ(ini.Get("s", "k"), "caf\u00E9 \u20AC?");
}

TEST(SettingsFileTest, WhyATextIsNotKept) {
  EXPECT_EQ(WhyNotKept(""), "");
  EXPECT_EQ(WhyNotKept("  c:\\data\\  "), "");
  EXPECT_EQ(WhyNotKept(std::string(60, 'x')), "");
  EXPECT_EQ(WhyNotKept("a\nb"), "");  // on one line it is kept
  EXPECT_EQ(WhyNotKept(std::string(61, 'x')), "is longer than 60 characters");
  EXPECT_EQ(WhyNotKept("\u4E2D"), "has characters that the settings can't hold");
  EXPECT_EQ(WhyNotKept("\xFF"), "has characters that the settings can't hold");
}

TEST(SettingsFileTest, WhatKeepsAFileFromBeingReadIsTold) {
  EXPECT_EQ(Ini().file.Fault(), "");
  EXPECT_EQ(Ini("[s]\r\n").file.Fault(), "");
  EXPECT_EQ(Ini(std::string(5u << 20, 'x')).file.Fault(), "The file is too large");
  Ini folder;
  folder.home.Put("Kora.ini/x", "x");
  EXPECT_NE(folder.file.Fault(), "");
  FailingIo io;
  Ini failing("[s]\r\n", io);
  io.failReadAt = 1;
  EXPECT_NE(failing.file.Fault(), "");
}

TEST(SettingsFileTest, FileThatCantBeReadHasNoKeysAndIsNotReplaced) {
  FailingIo io;
  Ini ini("[s]\r\nk=1\r\nm=2\r\n", io);
  io.failReadAt = 1;
  EXPECT_FALSE(ini.file.PutSetting("s", "k", "2"));
  io.failReadAt = 0;
  EXPECT_EQ(ini.text(), "[s]\r\nk=1\r\nm=2\r\n");
  EXPECT_EQ(ini.Get("s", "m"), "2");
}

TEST(SettingsFileTest, FileOfFiveMegabytesIsLeftAlone) {
  std::string text = "[s]\r\nk=1\r\n";
  text.resize(5u << 20, 'x');
  Ini ini(text);
  EXPECT_EQ(ini.Get("s", "k"), "unknown");
  EXPECT_FALSE(ini.file.PutSetting("s", "k", "2"));
  EXPECT_EQ(ini.text(), text);
}

TEST(SettingsFileTest, FolderInItsPlace) {
  Ini ini;
  ini.home.Put("Kora.ini/x", "x");
  EXPECT_EQ(ini.Get("s", "k"), "unknown");
  EXPECT_FALSE(ini.file.PutSetting("s", "k", "2"));
  EXPECT_EQ(ini.home.Get("Kora.ini/x"), "x");
}

TEST(SettingsFileTest, BinaryRubbishHasNoKeysOfOursAndSurvivesAWrite) {
  std::string rubbish;
  std::uint32_t x = 12345;
  for (int i = 0; i < 65536; ++i) rubbish += char((x = x * 1664525u + 1013904223u) >> 24);
  Ini ini(rubbish);
  EXPECT_EQ(ini.Get("Charts", "Type"), "unknown");
  EXPECT_TRUE(ini.file.PutSetting("Charts", "Type", "B"));
  EXPECT_EQ(ini.Get("Charts", "Type"), "B");
  // Line ends become CR LF; every other byte stays.
  const auto bare = [](std::string text) {
    std::erase_if(text, [](char c) { return c == '\r' || c == '\n'; });
    return text;
  };
  EXPECT_EQ(bare(ini.text()), bare(rubbish) + "[Charts]Type=B");
}
