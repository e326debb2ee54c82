// Model documents made from bytes by the grammar of the schema: bytes choose
// fields, words, numbers and ids. A change of one byte changes the structure.

#ifndef FUZZ_HX_DOCUMENTGRAMMAR_H
#define FUZZ_HX_DOCUMENTGRAMMAR_H

#include <string>

#include "fuzz/HX_Fuzz.h"

/// A document of the form that the schema asks for, nearly always; uses of ids
/// mostly find an item.
std::string HX_DocumentFrom(HX_Bytes& bytes);

#endif  // FUZZ_HX_DOCUMENTGRAMMAR_H
