// Makes model documents of any size, for trying scale.

#ifndef HOST_MODEL_HX_SYNTHESIS_H
#define HOST_MODEL_HX_SYNTHESIS_H

#include <cstdint>
#include <iosfwd>

/// Writes a document with \p blocks blocks in subsystems of 50 and one variable
/// for each, some of which share their wanted name, depend on others or need to
/// be shortened. The same arguments give the same text on every machine.
void HX_Synthesize(std::ostream& out, int blocks, std::uint64_t seed);

#endif  // HOST_MODEL_HX_SYNTHESIS_H
