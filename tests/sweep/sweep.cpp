#include "sweep/sweep.h"

#include <algorithm>
#include <bit>
#include <cmath>
#include <cstdio>
#include <cstring>
#include <utility>

#include "frame/numeric.h"

namespace sweep {
namespace {

constexpr double kGarbage = -123.456;

constexpr int32_t kRecords = 0;  // in place of a type code

uint64_t Product(const std::vector<int32_t>& dimensions) {
    uint64_t product = 1;
    for (const int32_t dimension : dimensions) product *= static_cast<uint64_t>(dimension);
    return product;
}

std::string Hexadecimal(const void* bytes, uint64_t count) {
    std::string text;
    char byte[3];
    for (uint64_t i = 0; i < count; ++i) {
        std::snprintf(byte, sizeof byte, "%02x", static_cast<const unsigned char*>(bytes)[i]);
        text += byte;
    }
    return text;
}

}  // namespace

std::vector<Entry>& Entries() {
    static std::vector<Entry> entries;
    return entries;
}

Scene::~Scene() {
    for (const Array& array : arrays_) KrrtFree(array.handle);
    for (const Scalars* scalars : scalars_) delete scalars;
    for (const int32_t* integer : integers_) delete integer;
}

KrHandle Scene::NewArray(int32_t type_code, std::vector<int32_t> dimensions, const void* elements) {
    uint64_t count = Product(dimensions);
    std::vector<char> varied;
    if (variation_ != nullptr) {
        const uint64_t original = count;
        variation_->Resize(&dimensions);
        count = Product(dimensions);
        varied = variation_->Elements(type_code, elements, original, count);
        elements = varied.data();
    }
    const std::vector<int32_t>& d = dimensions;
    const KrHandle handle = d.size() == 1   ? KrrtNewArray(type_code, d[0])
                            : d.size() == 2 ? KrrtNewMatrix(type_code, d[0], d[1])
                                            : KrrtNewCube(type_code, d[0], d[1], d[2]);
    if (count > 0) std::memcpy(KrrtElements(handle), elements, count * ElementBytes(type_code));
    return Keep(handle, type_code);
}

KrHandle Scene::NewRecords(int32_t bytes, int32_t count, const void* elements) {
    const KrHandle handle = KrrtNewRecords(bytes, count);
    if (count > 0) std::memcpy(KrrtElements(handle), elements, static_cast<size_t>(bytes) * static_cast<size_t>(count));
    return Keep(handle, kRecords);
}

KrHandle Scene::Keep(KrHandle handle, int32_t type_code) {
    if (malformed_ != nullptr && std::cmp_equal(malformed_->array, arrays_.size())) {
        malformed_->met = true;
        for (int32_t axis = 0; axis < KrrtRank(handle); ++axis) KrrtSetSize(handle, axis, malformed_->size);
    }
    arrays_.push_back({handle, type_code, false, OnFailure::kOther});
    return handle;
}

KrHandle Scene::Alias(KrHandle handle) {
    const size_t other = variation_->Choice(arrays_.size() + 1);
    const auto array = std::ranges::find(arrays_, handle, &Array::handle);
    if (other == 0 || array == arrays_.end()) return handle;
    const Array& candidate = arrays_[other - 1];
    const bool same_kind = array->type_code != kRecords && array->type_code == candidate.type_code &&
                           KrrtRank(handle) == KrrtRank(candidate.handle);
    // What two outputs in one array leave there is nobody's promise.
    return same_kind && !(array->output && candidate.output) ? candidate.handle : handle;
}

KrHandle Scene::NewOutput(int32_t type_code, int rank, OnFailure on_failure) {
    const double garbage[12] = {kGarbage, kGarbage, kGarbage, kGarbage, kGarbage, kGarbage,
                                kGarbage, kGarbage, kGarbage, kGarbage, kGarbage, kGarbage};
    const KrHandle handle = rank == 1 ? NewArray(type_code, {3}, garbage) : NewArray(type_code, {3, 2}, garbage);
    return Replaced(handle, on_failure);
}

KrHandle Scene::Replaced(KrHandle input, OnFailure on_failure) {
    for (Array& array : arrays_)
        if (array.handle == input) array = {input, array.type_code, true, on_failure};
    return input;
}

KrHandle Scene::Doubles(std::vector<double> v) {
    return NewArray(KRRT_DOUBLE, {static_cast<int32_t>(v.size())}, v.data());
}
KrHandle Scene::Complexes(std::vector<krnumer::Complex> v) {
    return NewArray(KRRT_COMPLEX, {static_cast<int32_t>(v.size())}, v.data());
}
KrHandle Scene::Integers(std::vector<int32_t> v) {
    return NewArray(KRRT_INT32, {static_cast<int32_t>(v.size())}, v.data());
}
KrHandle Scene::Bytes(std::vector<uint8_t> v) {
    return NewArray(KRRT_UINT8, {static_cast<int32_t>(v.size())}, v.data());
}
KrHandle Scene::Matrix(int32_t rows, int32_t columns, std::vector<double> v) {
    return NewArray(KRRT_DOUBLE, {rows, columns}, v.data());
}
KrHandle Scene::ComplexMatrix(int32_t rows, int32_t columns, std::vector<krnumer::Complex> v) {
    return NewArray(KRRT_COMPLEX, {rows, columns}, v.data());
}
KrHandle Scene::IntegerMatrix(int32_t rows, int32_t columns, std::vector<int32_t> v) {
    return NewArray(KRRT_INT32, {rows, columns}, v.data());
}
KrHandle Scene::Cube(int32_t pages, int32_t rows, int32_t columns, std::vector<double> v) {
    return NewArray(KRRT_DOUBLE, {pages, rows, columns}, v.data());
}

KrHandle Scene::OutDoubles(OnFailure f) {
    return NewOutput(KRRT_DOUBLE, 1, f);
}
KrHandle Scene::OutComplexes(OnFailure f) {
    return NewOutput(KRRT_COMPLEX, 1, f);
}
KrHandle Scene::OutIntegers(OnFailure f) {
    return NewOutput(KRRT_INT32, 1, f);
}
KrHandle Scene::OutMatrix(OnFailure f) {
    return NewOutput(KRRT_DOUBLE, 2, f);
}
KrHandle Scene::OutComplexMatrix(OnFailure f) {
    return NewOutput(KRRT_COMPLEX, 2, f);
}
KrHandle Scene::OutIntegerMatrix(OnFailure f) {
    return NewOutput(KRRT_INT32, 2, f);
}

double* Scene::Numbers(int32_t count, OnFailure on_failure) {
    scalars_.push_back(new Scalars{std::vector<double>(static_cast<size_t>(count), kGarbage), true, on_failure});
    return scalars_.back()->values.data();
}

double* Scene::State(double value) {
    if (variation_ != nullptr) value = variation_->Of(value);
    scalars_.push_back(new Scalars{{value}, false, OnFailure::kOther});
    return scalars_.back()->values.data();
}

int32_t* Scene::Integer(int32_t value) {
    if (variation_ != nullptr) value = variation_->Of(value);
    integers_.push_back(new int32_t{value});
    return integers_.back();
}

int32_t* Scene::err() {
    err_asked_ = true;
    return &err_;
}

std::string Scene::Results() const {
    // To the bit; only under variation is one NaN as good as another, for an operation on two NaN may give either.
    const auto Numbers = [this](const void* elements, uint64_t bytes) {
        std::vector<double> values(bytes / sizeof(double));
        if (!values.empty()) std::memcpy(values.data(), elements, bytes);
        for (double& value : values)
            if (variation_ != nullptr && std::isnan(value)) value = krnumer::kQuietNaN;
        return Hexadecimal(values.data(), bytes);
    };
    std::string text = std::to_string(status_);
    for (const Array& array : arrays_) {
        text += "; ";
        for (int32_t axis = 0; axis < KrrtRank(array.handle); ++axis)
            text += std::to_string(KrrtSize(array.handle, axis)) + " ";
        const uint64_t words = 4 * static_cast<uint64_t>(KrrtRank(array.handle));
        const uint64_t bytes = KrrtBytes(array.handle) - words;
        const bool doubles = array.type_code == KRRT_DOUBLE || array.type_code == KRRT_COMPLEX;
        text += doubles ? Numbers(KrrtElements(array.handle), bytes) : Hexadecimal(KrrtElements(array.handle), bytes);
    }
    for (const Scalars* scalars : scalars_)
        text += "; " + Numbers(scalars->values.data(), scalars->values.size() * sizeof(double));
    for (const int32_t* integer : integers_) text += "; " + std::to_string(*integer);
    return text;
}

std::string Scene::NotCleared() const {
    int position = 0;
    for (const Array& array : arrays_) {
        ++position;
        if (!array.output || array.on_failure == OnFailure::kOther) continue;
        for (int32_t axis = 0; axis < KrrtRank(array.handle); ++axis)
            if (KrrtSize(array.handle, axis) != 0) return "array " + std::to_string(position) + " is not empty";
    }
    for (const Scalars* scalars : scalars_) {
        if (!scalars->output || scalars->on_failure == OnFailure::kOther) continue;
        for (const double value : scalars->values)
            if (std::bit_cast<uint64_t>(value) != std::bit_cast<uint64_t>(krnumer::kQuietNaN))
                return "a scalar holds " + std::to_string(value);
    }
    return {};
}

}  // namespace sweep
