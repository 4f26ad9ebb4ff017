// Arrays of the substitute host for tests, freed at the end of their scope, and guards for its settings.
//
//     HostArray<double> x{1, 2, 3}, y;                          y is empty
//     HostMatrix<double> a(2, 3, {1, 2, 3, 4, 5, 6});
//     EXPECT_EQ(SomeExport(x.handle(), y.handle()), 0);
//     EXPECT_THAT(y.values(), ElementsAre(1, 4, 9));
//
// Elements are read and written by copies, so tests hold at every alignment.
#pragma once

#include <cstring>
#include <initializer_list>
#include <span>
#include <stdexcept>
#include <type_traits>
#include <utility>
#include <vector>

#include "krrt/krrt.h"
#include "support/numbers.h"

namespace krnumer {

// The type code of an element; 0 for a record, which has none.
template <class T>
constexpr int32_t TypeCode() {
    if constexpr (std::is_same_v<T, int32_t>) return KRRT_INT32;
    if constexpr (std::is_same_v<T, uint8_t>) return KRRT_UINT8;
    if constexpr (std::is_same_v<T, uint32_t>) return KRRT_UINT32;
    if constexpr (std::is_same_v<T, double>) return KRRT_DOUBLE;
    if constexpr (std::is_same_v<T, Complex> || std::is_same_v<T, KrComplex>) return KRRT_COMPLEX;
    return 0;
}

// What arrays of all kinds share. Owns the handle, which is never null.
class HostBlock {
  public:
    HostBlock(HostBlock&& other) noexcept : handle_(std::exchange(other.handle_, nullptr)) {}
    HostBlock& operator=(HostBlock&& other) noexcept {
        std::swap(handle_, other.handle_);
        return *this;
    }
    ~HostBlock() { KrrtFree(handle_); }

    KrHandle handle() const { return handle_; }

    // Dimension words as they stand in the block, whatever it really holds.
    int32_t dimension(int32_t i) const { return KrrtSize(handle_, i); }
    void SetDimension(int32_t i, int32_t size) { KrrtSetSize(handle_, i, size); }

    // All dimension words are 0.
    bool empty() const;

  protected:
    explicit HostBlock(KrHandle handle);  // throws std::bad_alloc on null

    // Elements by the dimension words; throws std::length_error when the block is too short for them.
    std::size_t Count(std::size_t element_bytes) const;

    std::byte* Element(std::size_t i, std::size_t element_bytes) const {
        return static_cast<std::byte*>(KrrtElements(handle_)) + i * element_bytes;
    }

  private:
    KrHandle handle_;
};

template <class T>
class HostElements : public HostBlock {
    static_assert(std::is_trivially_copyable_v<T>);

  public:
    // All elements, row after row.
    std::vector<T> values() const {
        std::vector<T> copy(Count(sizeof(T)));
        if (!copy.empty()) std::memcpy(copy.data(), Element(0, sizeof(T)), copy.size() * sizeof(T));
        return copy;
    }

  protected:
    using HostBlock::HostBlock;

    T Get(std::size_t i) const {
        T value;
        std::memcpy(&value, Checked(i), sizeof(T));
        return value;
    }
    void Put(std::size_t i, const T& value) { std::memcpy(Checked(i), &value, sizeof(T)); }

    void Fill(std::span<const T> values) {
        if (values.size() != Count(sizeof(T))) throw std::length_error("values do not fit the dimensions");
        if (!values.empty()) std::memcpy(Element(0, sizeof(T)), values.data(), values.size_bytes());
    }

  private:
    std::byte* Checked(std::size_t i) const {
        if (i >= Count(sizeof(T))) throw std::out_of_range("no such element");
        return Element(i, sizeof(T));
    }
};

// 1-D. Elements are doubles, Complex, int32_t, uint32_t, uint8_t or any packed record.
template <class T>
class HostArray : public HostElements<T> {
  public:
    HostArray() : HostArray(0) {}
    explicit HostArray(int32_t size) : HostElements<T>(New(size)) {}  // zeros
    HostArray(std::initializer_list<T> values) : HostArray(std::span<const T>(values.begin(), values.size())) {}
    explicit HostArray(const std::vector<T>& values) : HostArray(std::span<const T>(values)) {}
    explicit HostArray(std::span<const T> values) : HostArray(static_cast<int32_t>(values.size())) {
        this->Fill(values);
    }

    int32_t size() const { return this->dimension(0); }
    T operator[](int32_t i) const { return this->Get(static_cast<std::size_t>(i)); }
    void Set(int32_t i, const T& value) { this->Put(static_cast<std::size_t>(i), value); }

  private:
    static KrHandle New(int32_t size) {
        if constexpr (TypeCode<T>() == 0) return KrrtNewRecords(sizeof(T), size);
        return KrrtNewArray(TypeCode<T>(), size);
    }
};

// 2-D, row after row.
template <class T>
class HostMatrix : public HostElements<T> {
  public:
    HostMatrix() : HostMatrix(0, 0) {}
    HostMatrix(int32_t rows, int32_t columns) : HostElements<T>(KrrtNewMatrix(TypeCode<T>(), rows, columns)) {}
    HostMatrix(int32_t rows, int32_t columns, std::initializer_list<T> values)
        : HostMatrix(rows, columns, std::span<const T>(values.begin(), values.size())) {}
    HostMatrix(int32_t rows, int32_t columns, const std::vector<T>& values)
        : HostMatrix(rows, columns, std::span<const T>(values)) {}
    HostMatrix(int32_t rows, int32_t columns, std::span<const T> values) : HostMatrix(rows, columns) {
        this->Fill(values);
    }

    int32_t rows() const { return this->dimension(0); }
    int32_t columns() const { return this->dimension(1); }
    T operator()(int32_t row, int32_t column) const { return this->Get(Index(row, column)); }
    void Set(int32_t row, int32_t column, const T& value) { this->Put(Index(row, column), value); }

  private:
    std::size_t Index(int32_t row, int32_t column) const {
        if (row < 0 || column < 0 || column >= columns()) throw std::out_of_range("no such element");
        return static_cast<std::size_t>(row) * static_cast<std::size_t>(columns()) + static_cast<std::size_t>(column);
    }
};

// 3-D: pages of rows of columns.
template <class T>
class HostCube : public HostElements<T> {
  public:
    HostCube() : HostCube(0, 0, 0) {}
    HostCube(int32_t pages, int32_t rows, int32_t columns)
        : HostElements<T>(KrrtNewCube(TypeCode<T>(), pages, rows, columns)) {}
    HostCube(int32_t pages, int32_t rows, int32_t columns, std::initializer_list<T> values)
        : HostCube(pages, rows, columns, std::span<const T>(values.begin(), values.size())) {}
    HostCube(int32_t pages, int32_t rows, int32_t columns, const std::vector<T>& values)
        : HostCube(pages, rows, columns, std::span<const T>(values)) {}
    HostCube(int32_t pages, int32_t rows, int32_t columns, std::span<const T> values) : HostCube(pages, rows, columns) {
        this->Fill(values);
    }

    int32_t pages() const { return this->dimension(0); }
    int32_t rows() const { return this->dimension(1); }
    int32_t columns() const { return this->dimension(2); }
    T operator()(int32_t page, int32_t row, int32_t column) const { return this->Get(Index(page, row, column)); }
    void Set(int32_t page, int32_t row, int32_t column, const T& value) { this->Put(Index(page, row, column), value); }

  private:
    std::size_t Index(int32_t page, int32_t row, int32_t column) const {
        if (page < 0 || row < 0 || row >= rows() || column < 0 || column >= columns()) {
            throw std::out_of_range("no such element");
        }
        const auto size = [](int32_t n) { return static_cast<std::size_t>(n); };
        return (size(page) * size(rows()) + size(row)) * size(columns()) + size(column);
    }
};

// ---- Guards: a setting of the host for the scope, in the calling thread -------------------------------------------

class Guard {
  public:
    Guard(const Guard&) = delete;
    Guard& operator=(const Guard&) = delete;

  protected:
    Guard() = default;
};

// Elements of arrays created or resized in the scope stand at an odd multiple of 4 bytes.
class LeastAlignment : Guard {
  public:
    LeastAlignment() : former_(KrrtLeastAlignment(1)) {}
    ~LeastAlignment() { KrrtLeastAlignment(former_); }

  private:
    int32_t former_;
};

// Every resize moves the block. At the end of the scope a write to an abandoned block that has been freed since is a
// failure of the test.
class MovingBlocks : Guard {
  public:
    MovingBlocks() : former_(KrrtMovingBlocks(1)), stale_writes_(KrrtStaleWrites()) {}
    ~MovingBlocks() {
        KrrtMovingBlocks(former_);
        EXPECT_EQ(KrrtStaleWrites(), stale_writes_) << "a pointer was used after the resize that made it stale";
    }

  private:
    int32_t former_;
    int64_t stale_writes_;
};

// Blocks of more than `bytes` bytes are refused.
class BlockLimit : Guard {
  public:
    explicit BlockLimit(uint64_t bytes) : former_(KrrtBlockLimit(bytes)) {}
    ~BlockLimit() { KrrtBlockLimit(former_); }

  private:
    uint64_t former_;
};

// The nth resize to more than 0 elements, or by KRRT_RESIZES the nth of all, fails.
class FailResize : Guard {
  public:
    explicit FailResize(int32_t nth = 1, int32_t status = KRRT_OUT_OF_MEMORY, int32_t calls = KRRT_SIZINGS)
        : calls_(calls) {
        KrrtFail(calls, nth, status);
    }
    ~FailResize() { KrrtFail(calls_, 0, 0); }

    bool happened() const { return KrrtFailurePending(calls_) == 0; }

  private:
    int32_t calls_;
};

// The nth MakeBlock or SizeBlock fails.
class FailBlock : public FailResize {
  public:
    explicit FailBlock(int32_t nth = 1, int32_t status = KRRT_OUT_OF_MEMORY) : FailResize(nth, status, KRRT_BLOCKS) {}
};

// The resizes of the scope.
class ResizeLog : Guard {
  public:
    ResizeLog() { KrrtForgetResizes(); }

    int32_t size() const { return KrrtResizeCount(); }
    KrrtResize operator[](int32_t i) const;  // throws std::out_of_range
};

// An instance that is current in the scope; its clean-ups run at the end.
class HostInstance : Guard {
  public:
    HostInstance() : instance_(KrrtOpenInstance()), former_(KrrtUseInstance(instance_)) {}
    ~HostInstance() {
        KrrtUseInstance(former_);
        KrrtCloseInstance(instance_);
    }

    int32_t pending_cleanups() const { return KrrtPendingCleanups(instance_); }

  private:
    KrrtInstance* instance_;
    KrrtInstance* former_;
};

// Expects that whatever the host gave out in the scope has come back at its end.
class LeakCheck : Guard {
  public:
    LeakCheck() : live_blocks_(KrrtLiveBlocks()) {}
    ~LeakCheck() { EXPECT_EQ(KrrtLiveBlocks(), live_blocks_) << "blocks of the host were not freed"; }

    int64_t live_before() const { return live_blocks_; }

  private:
    int64_t live_blocks_;
};

}  // namespace krnumer
