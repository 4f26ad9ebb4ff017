// Transforms that outgrow the caches. The stages of their first factors combine rows that are far apart; they are run
// in tiles, some columns of many rows, which are copied out of the data and back: the data are gone through once for
// several stages, and rows at distances of powers of two do not drive each other out.
#pragma once

#include <cstddef>
#include <cstdint>

#include "fft/table.h"

namespace krnumer {

// Whether elements T, Complex or double, of the table's length stay in the second-level cache, and whether they come
// from memory.
template <class T>
bool AreCached(const qmfft_table* table);
template <class T>
bool AreFar(const qmfft_table* table);

// How many of the first factors should have their stages run in tiles. The table's factors and kernels must stand; 0
// where one lacks vector kernels.
template <class T>
int32_t CountTiledFactors(const qmfft_table* table);

// How many neighbouring sub-sequences of `length` elements are transformed together before: as many as the cache holds.
inline constexpr int32_t kMostLanes = 64;
template <class T>
int32_t LanesBeforeTiles(int32_t length);

// The doubles that such sub-sequences, or a tile, take; both lie on the stack. So does what is lost between their rows.
inline constexpr int32_t kTileDoubles = 32 * 1024;
inline constexpr int32_t kPaddingDoubles = 2 * 1024;

// Runs these stages in place. The sub-sequences of all other factors are done.
template <class T>
void CombineInTiles(const qmfft_table* table, T* data);

// Twiddles of such a factor i in the order of the tiles: tile after tile, in each the rows of one column after the
// other as the stage takes them, in vectors as elsewhere. What is behind the last column is 1.
template <class T>
size_t PackedCountInTiles(const qmfft_table* table, int32_t i);
template <class T>
void PackTwiddlesInTiles(const qmfft_table* table, int32_t i, double* packed);

}  // namespace krnumer
