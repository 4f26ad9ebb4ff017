#include "frame/entry.h"

#include <cstdlib>

#include "frame/host.h"
#include "frame/memory.h"

namespace krnumer {

int32_t Call::Fail(int32_t status) {
    for (ArrayView* array = arrays_; array != nullptr; array = array->next_)
        if (array->emptied_by_failure()) array->Empty();
    for (ScalarView* scalar = scalars_; scalar != nullptr; scalar = scalar->next_)
        for (size_t offset = 0; offset < scalar->bytes_; offset += sizeof kQuietNaN)
            std::memcpy(static_cast<char*>(scalar->target_) + offset, &kQuietNaN, sizeof kQuietNaN);
    return Leave(status);
}

int32_t Call::HostFailure(int32_t host_status) {
    Fail(kOutOfMemory);
    return host_status;
}

int32_t Call::Leave(int32_t status) {
    if (err_ == nullptr) return status;
    *err_ = status;
    return kOk;
}

int32_t Call::Deliver(int32_t status) {
    if (status < 0) return Fail(status);
    for (ScalarView* scalar = scalars_; scalar != nullptr; scalar = scalar->next_)
        std::memcpy(scalar->target_, scalar->value_, scalar->bytes_);
    return Leave(status);
}

int32_t Call::Map() {
    for (ArrayView* array = arrays_; array != nullptr; array = array->next_) {
        if (array->writes() && array->sized_ && !array->separate_) {
            if (const int32_t status = array->SeparateOthers()) return status;
        }
        if (const int32_t status = array->Map()) return status;
    }
    return kOk;
}

ArrayView::ArrayView(Call& call, KrHandle handle, Access access, ElementKind kind, int rank)
    : call_(&call),
      handle_(handle),
      field_(nullptr),
      kind_(kind),
      empty_type_code_(kind.type_code),
      rank_(static_cast<int8_t>(rank)),
      access_(access),
      sized_(reads()) {
    std::memcpy(dimensions_, *handle_, sizeof(int32_t) * static_cast<size_t>(rank_));
    *call.next_array_ = this;
    call.next_array_ = &next_;
}

ArrayView::ArrayView(Call& call, HandleField field, Access access, ElementKind kind, int rank)
    : ArrayView(
          call,
          [field] {
              KrHandle handle;
              std::memcpy(&handle, field.address, sizeof handle);
              return handle;
          }(),
          access, kind, rank) {
    field_ = field.address;
}

size_t ArrayView::count() const {
    size_t product = 1;
    for (int axis = 0; axis < rank_; ++axis) product *= Count(dimensions_[axis]);
    return product;
}

// Elements already in a copy stay there; those in the block are looked up anew, since any resize may have moved it.
int32_t ArrayView::Map() {
    if (copy_ != nullptr || !sized_) return kOk;
    const bool aligned = reinterpret_cast<uintptr_t>(area()) % kind_.alignment == 0;
    if (!separate_ && (aligned || count() == 0)) {
        data_ = area();
        return kOk;
    }
    return TakeCopy();
}

int32_t ArrayView::TakeCopy() {
    const size_t bytes = count() * kind_.bytes;
    copy_ = AllocateMemory(bytes);
    if (copy_ == nullptr) return kOutOfMemory;
    std::memcpy(copy_, area(), bytes);
    data_ = copy_;
    return kOk;
}

// From now on this array lives in a copy of its own, because another argument takes over the block.
int32_t ArrayView::Separate() {
    if (separate_) return kOk;
    if (copy_ == nullptr && sized_) {
        if (const int32_t status = TakeCopy()) return status;
    }
    separate_ = true;
    return kOk;
}

int32_t ArrayView::SeparateOthers() {
    for (ArrayView* other = call_->arrays_; other != nullptr; other = other->next_) {
        if (other == this || other->handle_ != handle_) continue;
        if (const int32_t status = other->Separate()) return status;
    }
    return kOk;
}

// Puts the elements where the caller sees them, unless the block serves another argument by now.
void ArrayView::ReleaseCopy() {
    if (writes() && !separate_) std::memcpy(area(), copy_, count() * kind_.bytes);
    DropCopy();
}

void ArrayView::DropCopy() {
    std::free(copy_);
    copy_ = nullptr;
    data_ = nullptr;
}

int32_t ArrayView::ResizeBlock(int32_t type_code, int32_t total) {
    const int32_t status = host::ResizeNumberBlock(type_code, rank_, &handle_, total);
    if (field_ != nullptr) std::memcpy(field_, &handle_, sizeof handle_);
    return status;
}

void ArrayView::StoreDimensions(const int32_t* dimensions) {
    const size_t bytes = sizeof(int32_t) * static_cast<size_t>(rank_);
    std::memcpy(dimensions_, dimensions, bytes);
    std::memcpy(*handle_, dimensions, bytes);
}

int32_t ArrayView::ResizeTo(const int32_t* dimensions) {
    if (const int32_t status = SeparateOthers()) return status;
    if (copy_ != nullptr) ReleaseCopy();
    separate_ = false;
    data_ = nullptr;

    int64_t total = 1;
    for (int axis = 0; axis < rank_; ++axis) {
        total *= dimensions[axis];
        if (total < 0 || total > std::numeric_limits<int32_t>::max()) return kOutOfMemory;
    }
    if (const int32_t status = ResizeBlock(kind_.type_code, static_cast<int32_t>(total))) return status;
    DeclareAs(dimensions);
    return kOk;
}

void ArrayView::DeclareAs(const int32_t* dimensions) {
    StoreDimensions(dimensions);
    sized_ = true;
}

void ArrayView::Empty() {
    constexpr int32_t kNone[3] = {0, 0, 0};
    DropCopy();
    ResizeBlock(empty_type_code_, 0);
    StoreDimensions(kNone);
}

int32_t ArrayView::Clear() {
    if (const int32_t status = SeparateOthers()) return status;
    Empty();
    return kOk;
}

void ArrayView::ReleaseElements() {
    DropCopy();
    ResizeBlock(kind_.type_code, 0);
    sized_ = false;
}

void ArrayView::Fill(const void* elements) {
    std::memcpy(copy_ != nullptr ? copy_ : area(), elements, count() * kind_.bytes);
}

}  // namespace krnumer
