// The frame of an entry point: how arrays and scalars of the host are seen, sized and left behind.
//
// An entry point declares its call and then its arguments in their order, checks, sizes its outputs, and runs the
// core:
//
//     int32_t histgran_head(KrHandle x, const int32_t* bins, KrHandle histogram, KrHandle centers, int32_t* err) {
//         ByReference call(err);                       // *err = 0
//         In<double> samples(call, x);
//         Out<int32_t> counts(call, histogram);        // emptied by every failure, in the order of declaration
//         Out<double> middles(call, centers);
//         if (samples.size() < 1 || *bins < 1) return call.Fail(kEmptyInput);
//         if (auto host = middles.Resize(*bins)) return call.HostFailure(host);
//         if (auto host = counts.Resize(*bins)) return call.HostFailure(host);
//         return call.Run([&] { return Histogram(samples.data(), samples.size(), ...); });
//     }
//
// Elements may lie at any 4-byte boundary. Where that suits the element type, a view hands out the host's own area;
// otherwise an aligned copy, written back at the end. An array that is passed both as input and as output is read
// from a copy. Cores see neither.
#pragma once

#include <cstddef>
#include <cstdint>
#include <cstring>
#include <type_traits>

#include "frame/complex.h"
#include "frame/numeric.h"
#include "frame/status.h"
#include "krnumer/types.h"

namespace krnumer {

class ArrayView;
class ScalarView;

// One call of an entry point: its outputs, and how its status is delivered.
class Call {
  public:
    Call(const Call&) = delete;
    Call& operator=(const Call&) = delete;

    // Empties array outputs, turns scalar outputs into NaN and delivers the status.
    int32_t Fail(int32_t status);

    // The same for a resize refused by the host, where the host's status is the function result: -20001 goes to *err.
    int32_t HostFailure(int32_t host_status);

    // Delivers the status and leaves all outputs as they are.
    int32_t Leave(int32_t status);

    // Fails on a negative status; otherwise the results stand and the status, 0 or a warning, is delivered.
    int32_t Deliver(int32_t status);

    // Makes the elements of all arrays accessible: of inputs, and of outputs that have been sized. -20001 when a copy
    // is needed and cannot be had.
    [[nodiscard]] int32_t Map();

    // Maps the arrays, runs the core and delivers its status.
    template <class Core>
    int32_t Run(Core&& core) {
        if (const int32_t status = Map()) return Fail(status);
        return Deliver(core());
    }

  protected:
    explicit Call(int32_t* err) : err_(err) {}
    ~Call() = default;

  private:
    friend class ArrayView;
    friend class ScalarView;

    int32_t* err_;  // null: the status is the function result
    ArrayView* arrays_ = nullptr;
    ArrayView** next_array_ = &arrays_;
    ScalarView* scalars_ = nullptr;
};

// The older form: the status goes to *err, which is cleared before anything else, and the function result is 0.
class ByReference : public Call {
  public:
    explicit ByReference(int32_t* err) : Call(err) { *err = kOk; }
};

// The newer form: the status is the function result.
class ByValue : public Call {
  public:
    ByValue() : Call(nullptr) {}
};

// Where the handle of an array lives when it is a field of a caller's record: at an address without alignment.
struct HandleField {
    void* address;
};

// The kind of an element as the host knows it. Records that the library only reads have no type code.
struct ElementKind {
    int32_t type_code;
    uint32_t bytes;
    uint32_t alignment;
};

template <class T>
inline constexpr ElementKind kElementKind{0, sizeof(T), alignof(T)};
template <>
inline constexpr ElementKind kElementKind<int32_t>{3, 4, 4};
template <>
inline constexpr ElementKind kElementKind<uint8_t>{5, 1, 1};
template <>
inline constexpr ElementKind kElementKind<uint32_t>{7, 4, 4};
template <>
inline constexpr ElementKind kElementKind<double>{10, 8, alignof(double)};
template <>
inline constexpr ElementKind kElementKind<Complex>{13, 16, alignof(Complex)};

// What an entry point does with an array argument.
enum class Access : uint8_t {
    kRead,          // input
    kWritten,       // output, emptied by a failure
    kReplaced,      // input and output in one, emptied by a failure
    kWrittenKept,   // output that a failure leaves as it is
    kReplacedKept,  // input and output in one that a failure leaves as it is
};

// One array argument, without its element type.
class ArrayView {
  public:
    ArrayView(const ArrayView&) = delete;
    ArrayView& operator=(const ArrayView&) = delete;

    // The dimension words as the array came, or as it was last resized.
    int32_t dimension(int axis) const { return dimensions_[axis]; }

    // Product of the dimension words; a word that a malformed block made negative counts as 0.
    size_t count() const;

    // Resizes to no elements and stores 0 in the dimension words.
    void Empty();

    // Empties an output before anything is looked at. -20001 when the block is that of an input as well, whose elements
    // have to be put aside first, and they cannot be.
    [[nodiscard]] int32_t Clear();

    // Resizes to no elements and leaves the dimension words as they are.
    void ReleaseElements();

    // The type code that Empty tells the host, where it is not that of the elements.
    void EmptyAs(int32_t type_code) { empty_type_code_ = type_code; }

  protected:
    ArrayView(Call& call, KrHandle handle, Access access, ElementKind kind, int rank);
    ArrayView(Call& call, HandleField field, Access access, ElementKind kind, int rank);
    ~ArrayView() {
        if (copy_ != nullptr) ReleaseCopy();
    }

    int32_t ResizeTo(const int32_t* dimensions);
    void DeclareAs(const int32_t* dimensions);
    void Fill(const void* elements);

    void* data_ = nullptr;  // the elements, once mapped

  private:
    friend class Call;

    bool reads() const { return access_ != Access::kWritten && access_ != Access::kWrittenKept; }
    bool writes() const { return access_ != Access::kRead; }
    bool emptied_by_failure() const { return access_ == Access::kWritten || access_ == Access::kReplaced; }

    char* area() const { return reinterpret_cast<char*>(*handle_) + sizeof(int32_t) * static_cast<size_t>(rank_); }
    int32_t Map();
    int32_t Separate();
    int32_t SeparateOthers();
    int32_t TakeCopy();
    void ReleaseCopy();
    void DropCopy();
    int32_t ResizeBlock(int32_t type_code, int32_t total);
    void StoreDimensions(const int32_t* dimensions);

    Call* call_;
    ArrayView* next_ = nullptr;
    KrHandle handle_;
    void* field_;  // where a changed handle goes back to; null for a handle passed by value
    void* copy_ = nullptr;
    ElementKind kind_;
    int32_t empty_type_code_;
    int32_t dimensions_[3];
    int8_t rank_;
    Access access_;
    bool sized_;             // the dimension words describe elements that may be touched
    bool separate_ = false;  // another argument took over the block: the copy is not written back
};

// Input array. Rank 1 has size(), rank 2 rows() and columns(), rank 3 pages() too.
template <class T, int Rank = 1>
class In;
// Output array: has the caller's dimensions until it is resized.
template <class T, int Rank = 1>
class Out;
// Input and output in one.
template <class T, int Rank = 1>
class InOut;

template <class T>
using InMatrix = In<T, 2>;
template <class T>
using OutMatrix = Out<T, 2>;
template <class T>
using InOutMatrix = InOut<T, 2>;

template <class T, int Rank>
class ShapedView : public ArrayView {
  public:
    int32_t size() const requires(Rank == 1) { return dimension(0); }
    int32_t pages() const requires(Rank == 3) { return dimension(0); }
    int32_t rows() const requires(Rank > 1) { return dimension(Rank - 2); }
    int32_t columns() const requires(Rank > 1) { return dimension(Rank - 1); }

  protected:
    template <class Handle>
    ShapedView(Call& call, Handle handle, Access access)
        : ArrayView(call, handle, access, kElementKind<std::remove_const_t<T>>, Rank) {}
};

template <class T, int Rank>
class In : public ShapedView<const T, Rank> {
  public:
    In(Call& call, KrHandle handle) : ShapedView<const T, Rank>(call, handle, Access::kRead) {}
    In(Call& call, HandleField field) : ShapedView<const T, Rank>(call, field, Access::kRead) {}

    const T* data() const { return static_cast<const T*>(this->data_); }
};

template <class T, int Rank>
class WritableView : public ShapedView<T, Rank> {
  public:
    T* data() { return static_cast<T*>(this->data_); }

    // Asks the host for the size and stores the dimension words; 0, or the status of the failure. Contents stay up to
    // the lesser size. Elements must be mapped (anew) afterwards.
    template <class... Dimensions>
    [[nodiscard]] int32_t Resize(Dimensions... dimensions) requires(sizeof...(Dimensions) == Rank) {
        const int32_t wanted[Rank] = {dimensions...};
        return this->ResizeTo(wanted);
    }

    // Stores dimension words for a block that is known to be long enough, without asking the host.
    template <class... Dimensions>
    void Declare(Dimensions... dimensions) requires(sizeof...(Dimensions) == Rank) {
        const int32_t wanted[Rank] = {dimensions...};
        this->DeclareAs(wanted);
    }

    // Copies all elements from elsewhere, without mapping.
    void Fill(const T* elements) { ArrayView::Fill(elements); }

  protected:
    using ShapedView<T, Rank>::ShapedView;
};

template <class T, int Rank>
class Out : public WritableView<T, Rank> {
  public:
    Out(Call& call, KrHandle handle, Access access = Access::kWritten) : WritableView<T, Rank>(call, handle, access) {}
    Out(Call& call, HandleField field, Access access = Access::kWritten) : WritableView<T, Rank>(call, field, access) {}
};

template <class T, int Rank>
class InOut : public WritableView<T, Rank> {
  public:
    InOut(Call& call, KrHandle handle, Access access = Access::kReplaced)
        : WritableView<T, Rank>(call, handle, access) {}
    InOut(Call& call, HandleField field, Access access = Access::kReplaced)
        : WritableView<T, Rank>(call, field, access) {}
};

// A scalar output, without its type.
class ScalarView {
  public:
    ScalarView(const ScalarView&) = delete;
    ScalarView& operator=(const ScalarView&) = delete;

  protected:
    ScalarView(Call& call, void* target, void* value, size_t bytes)
        : next_(call.scalars_), target_(target), value_(value), bytes_(bytes) {
        call.scalars_ = this;
    }
    ~ScalarView() = default;

  private:
    friend class Call;

    ScalarView* next_;
    void* target_;
    void* value_;
    size_t bytes_;
};

// A scalar output of one double or of several (Complex, or a record of doubles): the core's value when the call
// succeeds or warns, quiet NaN throughout when it fails. The target is written once, at the end, and needs no
// alignment.
template <class T = double>
class Result : public ScalarView {
    static_assert(std::is_trivially_copyable_v<T> && sizeof(T) % sizeof(double) == 0);

  public:
    Result(Call& call, void* target) : ScalarView(call, target, &value_, sizeof(T)) {}

    T* data() { return &value_; }
    T& operator*() { return value_; }
    T* operator->() { return &value_; }

  private:
    T value_{};
};

}  // namespace krnumer
