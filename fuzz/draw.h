#ifndef REISTI_FUZZ_DRAW_H
#define REISTI_FUZZ_DRAW_H

#include <cstdint>
#include <fuzzer/FuzzedDataProvider.h>

namespace fuzz {

// Where the bytes have run out, every function gives the value that a plain request would hold, so that short inputs
// are requests that succeed.

/// True one time in `parts`.
bool drawRarely(FuzzedDataProvider& bytes, int parts);

/// 1, a number up to `usualMost`, or any number.
std::uint32_t drawCount(FuzzedDataProvider& bytes, std::uint32_t usualMost);

/// A whole number of hundredths.
double drawHundredths(FuzzedDataProvider& bytes, int least, int most);

/// Numbers as people type them, their neighbours, the edges of the format, and any bit pattern.
double drawNumber(FuzzedDataProvider& bytes);

}  // namespace fuzz

#endif
