#pragma once

#include <cstdint>
#include <string>
#include <vector>

namespace kora::test {

// Damages the texts of a corpus, the same way in every run: bits and bytes changed, pieces cut
// out, put in, doubled or joined from two texts. `body` is called with each result; what it
// must hold under any input it checks itself.
class Mutator {
 public:
  explicit Mutator(std::uint32_t seed) : state_(seed * 2654435761u + 1) {}

  template <typename Body>
  void Run(const std::vector<std::string>& corpus, int times, Body body) {
    for (const std::string& text : corpus) body(text);
    for (int i = 0; i < times; ++i) {
      std::string text = corpus[Below(corpus.size())];
      for (size_t n = 1 + Below(4); n > 0; --n) Damage(text, corpus);
      body(text);
    }
  }

 private:
  size_t Below(size_t limit) {
    state_ = state_ * 6364136223846793005u + 1442695040888963407u;
    return size_t(state_ >> 33) % limit;
  }

  void Damage(std::string& text, const std::vector<std::string>& corpus) {
    static const std::string spice("\0\xFF\r\n,=[];\".-+ 0129\x80\x7F", 19);
    const size_t at = Below(text.size() + 1);
    const size_t size = 1 + Below(16);
    switch (Below(7)) {
      case 0:
        if (at < text.size()) text[at] = char(text[at] ^ (1 << Below(8)));
        break;
      case 1:
        if (at < text.size()) text[at] = char(Below(256));
        break;
      case 2: text.erase(at, size); break;
      case 3: text.resize(at); break;
      case 4: text.insert(at, size, spice[Below(spice.size())]); break;
      case 5:
        if (text.size() < 65536) text.insert(at, std::string(text, at, size * size));
        break;
      default: {
        const std::string& other = corpus[Below(corpus.size())];
        text = text.substr(0, at) + other.substr(Below(other.size() + 1));
      }
    }
  }

  std::uint64_t state_;
};

}  // namespace kora::test
