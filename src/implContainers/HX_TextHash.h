// Hash of a text, for tables of names in memory.

#ifndef IMPLCONTAINERS_HX_TEXTHASH_H
#define IMPLCONTAINERS_HX_TEXTHASH_H

#include <cstddef>
#include <cstdint>
#include <cstring>

namespace hx_detail {

template <class Word>
std::uint64_t wordAt(const char* text) {
  Word word;
  std::memcpy(&word, text, sizeof word);
  return word;
}

inline std::uint64_t mixed(std::uint64_t hash, std::uint64_t word) {
  hash = (hash ^ word) * 0x9E3779B97F4A7C15U;
  return hash ^ (hash >> 32);
}

}  // namespace hx_detail

/// COST: one multiplication per eight characters. The last step may read
/// characters of the step before once more. The result depends on the byte
/// order of the machine.
inline int HX_TextHash(const char* text, std::size_t length) {
  using hx_detail::mixed;
  using hx_detail::wordAt;
  std::uint64_t hash = length;
  if (length >= 8) {
    const char* const last = text + length - 8;
    for (; text < last; text += 8)
      hash = mixed(hash, wordAt<std::uint64_t>(text));
    hash = mixed(hash, wordAt<std::uint64_t>(last));
  } else if (length >= 4) {
    const std::uint64_t front = wordAt<std::uint32_t>(text);
    hash = mixed(hash, front << 32 | wordAt<std::uint32_t>(text + length - 4));
  } else {
    for (; length != 0; --length)
      hash = hash << 8 ^ wordAt<unsigned char>(text + length - 1);
    hash = mixed(hash, 0);
  }
  return static_cast<int>(mixed(hash, 0) >> 32);
}

#endif  // IMPLCONTAINERS_HX_TEXTHASH_H
