// Arena of texts: all texts die with the arena.
//
//   HX_TextArena texts;
//   const char* kept = texts.add("speed", 5);   // null without memory
//
// COST: length + 1 bytes per text, one block of the memory controller per 16000
// bytes, some hundreds of names.

#ifndef IMPLCONTAINERS_HX_TEXTARENA_H
#define IMPLCONTAINERS_HX_TEXTARENA_H

#include <algorithm>
#include <cstddef>
#include <cstring>

#include "Control/HX_Allocated.h"

/// OWNERSHIP: not copied, an arena belongs to one owner.
class HX_TextArena {
 public:
  HX_TextArena() = default;
  HX_TextArena(const HX_TextArena&) = delete;
  HX_TextArena& operator=(const HX_TextArena&) = delete;
  ~HX_TextArena() {
    while (m_Newest != nullptr) {
      Chunk* const earlier = m_Newest->earlier;
      HX_Free(m_Newest);
      m_Newest = earlier;
    }
  }

  /// Copies \p length characters of \p text and appends a zero.
  /// RETURNS: the copy, valid until the arena dies; null, with nothing changed,
  /// without memory.
  const char* add(const char* text, std::size_t length) {
    if (length >= m_Left && !addChunk(length + 1)) return nullptr;
    char* const kept = m_Next;
    std::memcpy(kept, text, length);
    kept[length] = 0;
    m_Next += length + 1;
    m_Left -= length + 1;
    return kept;
  }

  /// Removes the text of the last add(), which had \p length characters.
  void dropLast(std::size_t length) {
    m_Next -= length + 1;
    m_Left += length + 1;
  }

 private:
  struct Chunk {
    Chunk* earlier;  // the characters follow
  };
  static constexpr std::size_t kChunkSize = 16000;  // characters

  // The rest of the chunk before stays unused.
  bool addChunk(std::size_t wanted) {
    const std::size_t size = std::max(wanted, kChunkSize);
    void* const room = HX_Allocate(sizeof(Chunk) + size);
    if (room == nullptr) return false;
    auto* const chunk = static_cast<Chunk*>(room);
    chunk->earlier = m_Newest;
    m_Newest = chunk;
    m_Next = reinterpret_cast<char*>(chunk + 1);
    m_Left = size;
    return true;
  }

  Chunk* m_Newest = nullptr;
  char* m_Next = nullptr;  // in the newest chunk
  std::size_t m_Left = 0;  // characters from m_Next on
};

#endif  // IMPLCONTAINERS_HX_TEXTARENA_H
