#pragma once

#include <cstddef>
#include <string>
#include <string_view>
#include <vector>

namespace kora {

// What a run of the update did not take in as it stood, told at its end. All well: nothing.
class UpdateReport {
 public:
  // A downloaded file that was not taken in at all.
  void Refused(std::string_view file, std::string_view why);
  // Something of it that was left out: " ORE: its price file is full".
  void LeftOut(std::string_view file, std::string text);
  // A field that was read as far as it is a number.
  void Misread(std::string_view file, std::string text);

  bool refused() const { return refused_; }
  bool leftOut() const { return leftOut_; }
  bool misread() const { return misread_; }

  // The files in the order in which they were taken, the first twenty remarks of each.
  std::string Text() const;

 private:
  struct OfFile {
    std::string name;
    std::vector<std::string> lines;
    size_t more = 0;
  };
  void Add(std::string_view file, std::string line);

  std::vector<OfFile> files_;
  bool refused_ = false, leftOut_ = false, misread_ = false;
};

}  // namespace kora
