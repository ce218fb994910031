#include "maintenance/note_list.h"

#include "tests/maintenance/maintenance_fixture.h"

using namespace kora;
using namespace kora::test;

namespace {

class NoteListTest : public MaintenanceTest {
 protected:
  const std::string kNotes = "drive_c/korawin/chtmisc/ORE.Txt";
  const std::string kTwo = "T,8.25,19980914,1.50,first,255\r\nT,8.25,19980915,1.60,second,255\r\n";
};

}  // namespace

TEST_F(NoteListTest, ALineIsDroppedAndTheRestSaved) {
  home.Put(kNotes, kTwo);
  auto notes = OpenNotes(home.files(), kMisc, "ORE", dialogs);
  ASSERT_TRUE(notes);
  ASSERT_EQ(notes->lines.size(), 2u);
  EXPECT_EQ(NoteListText(notes->lines[0]), "14/9/98   1.50   first");
  notes->lines.erase(notes->lines.begin());
  EXPECT_TRUE(SaveNotes(home.files(), kMisc, "ORE", *notes, dialogs));
  EXPECT_EQ(home.Get(kNotes), "T,8.25,19980915,1.60,second,255\r\n");
  EXPECT_TRUE(SaveNotes(home.files(), kMisc, "ORE", *notes, dialogs));
  EXPECT_TRUE(dialogs.said.empty());
}

TEST_F(NoteListTest, ALineThatIsNoTextIsShownAsItStandsAndKeptByteForByte) {
  home.Put(kNotes,
           "; mine\r\nT,8.25,19980914,1.50,first,255\r\nT,8.25,19980915,1.60,b,255,more\r\n");
  auto notes = OpenNotes(home.files(), kMisc, "ORE", dialogs);
  ASSERT_TRUE(notes);
  ASSERT_EQ(notes->lines.size(), 3u);
  EXPECT_EQ(NoteListText(notes->lines[0]), "; mine");
  notes->lines.erase(notes->lines.begin() + 1);
  EXPECT_TRUE(SaveNotes(home.files(), kMisc, "ORE", *notes, dialogs));
  EXPECT_EQ(home.Get(kNotes), "; mine\r\nT,8.25,19980915,1.60,b,255,more\r\n");
}

TEST_F(NoteListTest, RemoveAllDeletesTheFile) {
  home.Put(kNotes, "T,8.25,19980914,1.50,first,255\r\n");
  EXPECT_TRUE(RemoveAllNotes(home.files(), kMisc, "ORE", dialogs));
  EXPECT_FALSE(home.Exists(kNotes));
  EXPECT_FALSE(OpenNotes(home.files(), kMisc, "ORE", dialogs));
  EXPECT_EQ(LastSaid(), "THERE IS NO TEXT FOR ORE");
}

TEST_F(NoteListTest, TextsThatAnotherProgramAddedAreNotSavedOverWithoutAQuestion) {
  home.Put(kNotes, kTwo);
  auto notes = OpenNotes(home.files(), kMisc, "ORE", dialogs);
  ASSERT_TRUE(notes);
  notes->lines.clear();
  const std::string more = kTwo + "T,8.25,19980916,1.70,third,255\r\n";
  home.Put(kNotes, more);
  EXPECT_FALSE(SaveNotes(home.files(), kMisc, "ORE", *notes, dialogs));
  EXPECT_EQ(LastSaid(), "The texts were changed by another program. Save over these changes ?");
  EXPECT_EQ(home.Get(kNotes), more);
  dialogs.answers = {Answer::kYes};
  EXPECT_TRUE(SaveNotes(home.files(), kMisc, "ORE", *notes, dialogs));
  EXPECT_EQ(home.Get(kNotes), "");
}

TEST_F(NoteListTest, AFailureLeavesTheTextsAsTheyWere) {
  home.Put(kNotes, "T,8.25,19980914,1.50,first,255\r\n");
  auto notes = OpenNotes(home.files(), kMisc, "ORE", dialogs);
  ASSERT_TRUE(notes);
  notes->lines.clear();
  EXPECT_GT(
      FailedEverywhere([&] { return SaveNotes(home.files(), kMisc, "ORE", *notes, dialogs); }), 2);
}
