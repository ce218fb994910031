#include "maintenance/code_change.h"

#include <algorithm>
#include <cstring>
#include <vector>

#include "base/file_set.h"
#include "base/runtime_error.h"
#include "base/text.h"
#include "maintenance/failures.h"
#include "maintenance/same_place.h"
#include "platform/dialogs.h"
#include "platform/progress.h"
#include "store/name_file.h"
#include "store/price_edit.h"

namespace kora {
namespace {

constexpr const char* kTitle = "Conversion";
constexpr const char* kFileTitle = "File details";

std::string Upper(const std::string& code) { return UCase(Trim(ToAnsi(code))); }

bool StartsWith(const std::vector<PriceRec>& all, const std::vector<PriceRec>& first) {
  return all.size() >= first.size() &&
         (first.empty() ||
          std::memcmp(all.data(), first.data(), first.size() * sizeof(PriceRec)) == 0);
}

// Gives the first record of the old code the new one. False when there is none.
bool ChangeName(std::vector<NameRec>& names, std::string_view oldCode, std::string_view newCode) {
  const auto at = std::find_if(names.begin(), names.end(), [&](const NameRec& rec) {
    return rec.Code.raw() == PadRight(oldCode, 6);
  });
  if (at == names.end()) return false;
  at->Code.set(newCode);
  return true;
}

}  // namespace

CodeChange ChangeCode(const Files& files, const std::string& dataPath, const std::string& oldText,
                      const std::string& newText, Progress& progress, Dialogs& dialogs,
                      CodeBox& focus) {
  const std::string oldCode = Upper(oldText), newCode = Upper(newText);
  focus = CodeBox::kNone;
  if (!IsFileCode(oldCode)) {
    focus = CodeBox::kOld;
    dialogs.Message("Invalid Code", "Old ASX Code");
    return CodeChange::kRefused;
  }
  if (!IsFileCode(newCode) || newCode == oldCode) {
    focus = CodeBox::kNew;
    dialogs.Message("Invalid Code", "New ASX Code");
    return CodeChange::kRefused;
  }
  const std::string oldFile = dataPath + CodeFileName(oldCode, ".WDT");
  const std::string newFile = dataPath + CodeFileName(newCode, ".WDT");
  CodeChange end = CodeChange::kRefused;
  TellFailure(dialogs, kTitle, oldFile, [&] {
    if (!files.CheckFile(oldFile)) {
      focus = CodeBox::kOld;
      dialogs.Message("Cannot find " + oldFile, kFileTitle);
      return;
    }
    if (IsSamePlace(files, oldFile, newFile)) {
      focus = CodeBox::kNew;
      dialogs.Message("Both codes have one file: " + newFile, kFileTitle);
      return;
    }
    const bool combine = files.CheckFile(newFile);
    if (!combine && dialogs.Ask("Cannot find " + newFile + "\nDo you want data for " + oldFile +
                                    " renamed to " + newFile + "?",
                                kFileTitle, Buttons::kYesNo) != Answer::kYes) {
      end = CodeChange::kDeclined;
      return;
    }
    bool named = false;
    {
      const auto held = files.lock().Hold();
      progress.Show(ProgressLine::kState, combine ? "COMBINING FILES" : "RENAMING FILES");
      // The new file is there before the old one goes, and before the name leads to it.
      FileSet set(files);
      if (combine) {
        PriceEdit kept(files, newFile);
        std::vector<PriceRec> all = PriceEdit(files, oldFile).records();
        if (!StartsWith(kept.records(), all)) {
          all.insert(all.end(), kept.records().begin(), kept.records().end());
          kept.records() = std::move(all);
          kept.Save(set);
        }
      } else {
        set.Add(newFile, files.ReadAll(oldFile));
      }
      progress.Show(ProgressLine::kState, "CHECKING NAME FILE");
      std::vector<NameRec> names = ReadNames(files, dataPath);
      named = ChangeName(names, oldCode, newCode);
      if (named) {
        progress.Show(ProgressLine::kState, "RENAMING NAME FILE ENTRY");
        StageNames(set, NameFilePath(dataPath), names);
      }
      set.Remove(oldFile);
      set.Commit();
    }
    progress.Show(ProgressLine::kState, "");
    end = CodeChange::kChanged;
    const std::string what = FromAnsi(oldCode), to = FromAnsi(newCode);
    if (named)
      dialogs.Message(std::string(combine ? "File converted and " : "Data file renamed and ") +
                          what + " changed to " + to + " in the NAME File",
                      kTitle);
    else
      dialogs.Message(std::string(combine ? "Files converted" : "Data file renamed") +
                          " but was unable to find entry for " + what + " the Name File",
                      kTitle);
    if (combine)
      dialogs.Message("The converted data file for " + to +
                          " may contain duplicate dates at the changeover point. Use View\\Modify "
                          "Data from the Main Menu to check and/or delete unwanted records.",
                      kTitle);
  });
  return end;
}

}  // namespace kora
