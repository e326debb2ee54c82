#include "host/base/HX_Sha256.h"

#include <array>
#include <bit>
#include <cstdint>

namespace {

using Word = std::uint32_t;

// Fractions of the cube roots of the first 64 primes.
constexpr Word kRounds[64] = {
    0x428A2F98, 0x71374491, 0xB5C0FBCF, 0xE9B5DBA5, 0x3956C25B, 0x59F111F1,
    0x923F82A4, 0xAB1C5ED5, 0xD807AA98, 0x12835B01, 0x243185BE, 0x550C7DC3,
    0x72BE5D74, 0x80DEB1FE, 0x9BDC06A7, 0xC19BF174, 0xE49B69C1, 0xEFBE4786,
    0x0FC19DC6, 0x240CA1CC, 0x2DE92C6F, 0x4A7484AA, 0x5CB0A9DC, 0x76F988DA,
    0x983E5152, 0xA831C66D, 0xB00327C8, 0xBF597FC7, 0xC6E00BF3, 0xD5A79147,
    0x06CA6351, 0x14292967, 0x27B70A85, 0x2E1B2138, 0x4D2C6DFC, 0x53380D13,
    0x650A7354, 0x766A0ABB, 0x81C2C92E, 0x92722C85, 0xA2BFE8A1, 0xA81A664B,
    0xC24B8B70, 0xC76C51A3, 0xD192E819, 0xD6990624, 0xF40E3585, 0x106AA070,
    0x19A4C116, 0x1E376C08, 0x2748774C, 0x34B0BCB5, 0x391C0CB3, 0x4ED8AA4A,
    0x5B9CCA4F, 0x682E6FF3, 0x748F82EE, 0x78A5636F, 0x84C87814, 0x8CC70208,
    0x90BEFFFA, 0xA4506CEB, 0xBEF9A3F7, 0xC67178F2};

constexpr std::size_t kBlock = 64;  // bytes

class Digest {
 public:
  void addBlock(std::string_view block) {
    Word w[64];
    for (std::size_t i = 0; i < 16; ++i) {
      w[i] = 0;
      for (std::size_t j = 0; j < 4; ++j)
        w[i] = w[i] << 8 | static_cast<unsigned char>(block[4 * i + j]);
    }
    for (std::size_t i = 16; i < 64; ++i)
      w[i] = w[i - 16] + w[i - 7] + mixed(w[i - 15], 7, 18, 3) +
             mixed(w[i - 2], 17, 19, 10);
    std::array<Word, 8> s = m_State;
    for (std::size_t i = 0; i < 64; ++i) {
      const Word choice = (s[4] & s[5]) ^ (~s[4] & s[6]);
      const Word majority = (s[0] & s[1]) ^ (s[0] & s[2]) ^ (s[1] & s[2]);
      const Word first =
          s[7] + turned(s[4], 6, 11, 25) + choice + kRounds[i] + w[i];
      const Word second = turned(s[0], 2, 13, 22) + majority;
      s = {first + second, s[0], s[1], s[2], s[3] + first, s[4], s[5], s[6]};
    }
    for (std::size_t i = 0; i < 8; ++i) m_State[i] += s[i];
  }

  std::string text() const {
    std::string digits;
    for (const Word word : m_State)
      for (int shift = 28; shift >= 0; shift -= 4)
        digits += "0123456789abcdef"[word >> shift & 15];
    return digits;
  }

 private:
  static Word turned(Word x, int a, int b, int c) {
    return std::rotr(x, a) ^ std::rotr(x, b) ^ std::rotr(x, c);
  }
  static Word mixed(Word x, int a, int b, int shift) {
    return std::rotr(x, a) ^ std::rotr(x, b) ^ (x >> shift);
  }

  // Fractions of the square roots of the first 8 primes.
  std::array<Word, 8> m_State{0x6A09E667, 0xBB67AE85, 0x3C6EF372, 0xA54FF53A,
                              0x510E527F, 0x9B05688C, 0x1F83D9AB, 0x5BE0CD19};
};

}  // namespace

std::string HX_Sha256(std::string_view text) {
  Digest digest;
  std::size_t at = 0;
  for (; at + kBlock <= text.size(); at += kBlock)
    digest.addBlock(text.substr(at, kBlock));
  // The rest, a bit 1, zeros, and the number of bits in 8 bytes.
  std::string rest(text.substr(at));
  rest += '\x80';
  while (rest.size() % kBlock != kBlock - 8) rest += '\0';
  const std::uint64_t bits = static_cast<std::uint64_t>(text.size()) * 8;
  for (int shift = 56; shift >= 0; shift -= 8)
    rest += static_cast<char>(bits >> shift & 0xFF);
  for (at = 0; at < rest.size(); at += kBlock)
    digest.addBlock(std::string_view(rest).substr(at, kBlock));
  return digest.text();
}
