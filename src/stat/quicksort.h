// Quicksort whose partition has no branch on the data, with a bound on its worst case.
#pragma once

#include <algorithm>
#include <bit>
#include <cstddef>
#include <type_traits>

namespace krnumer {

namespace quicksort {

// Runs up to this length (128 bytes of doubles) are left to insertion sort.
inline constexpr std::ptrdiff_t kRun = 16;

// A part of less than one in so many elements shows that the pivot was defeated. Random data hardly ever do that.
inline constexpr std::ptrdiff_t kDefeat = 32;

template <class T, class Before>
void InsertionSort(T* first, T* last, Before before) {
    for (T* next = first; next < last; ++next) {
        const T value = *next;
        T* hole = next;
        for (; hole > first && before(value, hole[-1]); --hole) *hole = hole[-1];
        *hole = value;
    }
}

// Moves the elements that belong to the front there and returns the end of the front. This is Lomuto's partition with
// a gap that travels between the two parts: where an element goes is an addition, not a jump, so that random data
// cost no mispredicted branch.
template <class T, class Belongs>
T* Partition(T* first, T* last, Belongs belongs) {
    if (first == last) return first;
    const T held = *first;
    T* front = first;
    T* gap = first;
    for (; gap < last - 1; ++gap) {
        *gap = *front;
        *front = gap[1];
        front += belongs(*front);
    }
    *gap = *front;
    *front = held;
    return front + belongs(held);
}

template <class T, class Before>
T MedianOfThree(T a, T b, T c, Before before) {
    return std::max(std::min(a, b, before), std::min(std::max(a, b, before), c, before), before);
}

// Brings each element of one range and its partner of another into order. Equal ones stay: a minimum and a maximum
// might be the same one of them.
template <class T, class Before>
void PutInOrder(T* first, T* second, std::ptrdiff_t count, Before before) {
    for (std::ptrdiff_t i = 0; i < count; ++i) {
        const T a = first[i], b = second[i];
        const T front = before(b, a) ? b : a;
        const T back = before(b, a) ? a : b;
        first[i] = front;
        second[i] = back;
    }
}

// The median of three medians of three medians and so on, of all elements: of 3^k of them at least 2^k lie to either
// side of it. The medians are gathered in the middle third (P. J. Rousseeuw and G. W. Bassett, The remedian, J. Am.
// Stat. Assoc. 85, 97, 1990).
template <class T, class Before>
T Remedian(T* first, std::ptrdiff_t count, Before before) {
    while (count >= 3) {
        const std::ptrdiff_t third = count / 3;
        T* const middle = first + third;
        T* const last = middle + third;
        PutInOrder(first, middle, third, before);
        PutInOrder(middle, last, third, before);
        PutInOrder(first, middle, third, before);
        first = middle;
        count = third;
    }
    return *first;
}

// The levels that a partition into halves would take, twice over: data that need more have defeated the pivot.
inline int MostLevels(std::ptrdiff_t count) {
    return 2 * static_cast<int>(std::bit_width(static_cast<std::size_t>(count)));
}

template <class T, class Before>
void Sort(T* first, T* last, Before before, int levels) {
    bool defeated = false;
    while (last - first > kRun) {
        if (levels-- == 0) {
            std::make_heap(first, last, before);
            std::sort_heap(first, last, before);
            return;
        }
        const std::ptrdiff_t count = last - first, quarter = count / 4;
        const T pivot = defeated ? Remedian(first, count, before)
                                 : MedianOfThree(first[quarter], first[2 * quarter], first[3 * quarter], before);
        T* middle = Partition(first, last, [=](T value) { return before(value, pivot); });
        defeated = middle != first && std::min(middle - first, last - middle) < count / kDefeat;
        if (middle == first) {
            // Nothing lies before the pivot: it and its equals are in place, and many equal elements cost one pass.
            first = Partition(first, last, [=](T value) { return !before(pivot, value); });
        } else if (middle - first < last - middle) {
            Sort(first, middle, before, levels);
            first = middle;
        } else {
            Sort(middle, last, before, levels);
            last = middle;
        }
    }
    InsertionSort(first, last, before);
}

}  // namespace quicksort

// Sorts by a strict weak order, in place and not stably. Hoare's quicksort (Computer J. 5, 10, 1962) with the median of
// three as pivot; the smaller part is sorted first, which keeps the stack logarithmic. Data that defeat the pivot get the
// median of medians of three for the next one, and heap sort where that fails again and again, so that no input costs
// more than O(n log n) (D. R. Musser, Introspective sorting and selection algorithms, Software Pract. Exper. 27, 983,
// 1997). Data in order or in reverse order are recognised.
template <class T, class Before>
void QuickSort(T* first, T* last, Before before) {
    static_assert(std::is_trivially_copyable_v<T>);
    if (std::adjacent_find(first, last, [=](T a, T b) { return before(b, a); }) == last) return;
    if (std::adjacent_find(first, last, before) == last) {
        std::reverse(first, last);
        return;
    }
    quicksort::Sort(first, last, before, quicksort::MostLevels(last - first));
}

}  // namespace krnumer
