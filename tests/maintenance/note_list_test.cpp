#include "maintenance/note_list.h"

#include "tests/maintenance/maintenance_fixture.h"

using namespace kora;
using namespace kora::test;

namespace {

class NoteListTest : public MaintenanceTest {
 protected:
  const std::string kNotes = "drive_c/korawin/chtmisc/ORE.Txt";
};

}  // namespace

TEST_F(NoteListTest, ALineIsDroppedAndTheRestSaved) {
  home.Put(kNotes, "T,8.25,19980914,1.50,first,255\r\nT,8.25,19980915,1.60,second,255\r\n");
  auto notes = OpenNotes(home.files(), kMisc, "ORE", dialogs);
  ASSERT_TRUE(notes);
  ASSERT_EQ(notes->size(), 2u);
  notes->erase(notes->begin());
  EXPECT_TRUE(SaveNotes(home.files(), kMisc, "ORE", *notes, dialogs));
  EXPECT_EQ(home.Get(kNotes), "T,8.25,19980915,1.60,second,255\r\n");
  EXPECT_TRUE(dialogs.said.empty());
}

TEST_F(NoteListTest, RemoveAllDeletesTheFile) {
  home.Put(kNotes, "T,8.25,19980914,1.50,first,255\r\n");
  EXPECT_TRUE(RemoveAllNotes(home.files(), kMisc, "ORE", dialogs));
  EXPECT_FALSE(home.Exists(kNotes));
  EXPECT_FALSE(OpenNotes(home.files(), kMisc, "ORE", dialogs));
  EXPECT_EQ(LastSaid(), "THERE IS NO TEXT FOR ORE");
}

TEST_F(NoteListTest, AFailureLeavesTheTextsAsTheyWere) {
  home.Put(kNotes, "T,8.25,19980914,1.50,first,255\r\n");
  EXPECT_GT(FailedEverywhere([&] { return SaveNotes(home.files(), kMisc, "ORE", {}, dialogs); }),
            2);
}
