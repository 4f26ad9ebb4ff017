// The export sweep: every export is called in every way in which it can be put under pressure.
//
// A scene builds the arguments of one successful call and makes it:
//
//     SWEEP(histgran_head) {
//         const KrHandle x = scene.Doubles({1, 2, 2.5, 3});
//         const int32_t bins = 2;
//         const KrHandle histogram = scene.OutIntegers();
//         const KrHandle centers = scene.OutDoubles();
//         return scene.Call(histgran_head, x, &bins, histogram, centers, scene.err());
//     }
//
// The sweep plays it: with both alignments of elements and with blocks that move at every resize, expecting the same
// results to the bit; with each resize failing in turn and each allocation failing in turn, expecting a clear status
// and outputs in their failure state; with garbage in *err and in the outputs beforehand; with each array in turn
// malformed, for the sanitizers to watch. It leaves no block of the host and no memory behind. The fuzzer plays the
// same scenes with varied arguments.
#pragma once

#include <array>
#include <cstdint>
#include <memory>
#include <string>
#include <tuple>
#include <type_traits>
#include <vector>

#include "frame/complex.h"
#include "frame/status.h"
#include "krrt/krrt.h"
#include "sweep/allocator.h"
#include "sweep/variation.h"

namespace sweep {

// The state in which a failure leaves an output.
enum class OnFailure {
    kEmptied,  // array without elements, or NaN
    kOther,    // whatever the function documents; not looked at
};

// An array whose dimension words a careless caller left below 0.
struct Malformed {
    int32_t array;     // which one of the scene, in the order in which they are made
    int32_t size;      // of all its dimensions
    bool met = false;  // the scene has such an array
};

class Scene {
  public:
    explicit Scene(int32_t refused_allocation = 0) : refused_allocation_(refused_allocation) {}
    explicit Scene(Variation* variation) : variation_(variation) {}
    explicit Scene(Malformed* malformed) : malformed_(malformed) {}
    ~Scene();
    Scene(const Scene&) = delete;
    Scene& operator=(const Scene&) = delete;

    // Inputs. Matrices take their elements row after row.
    KrHandle Doubles(std::vector<double> values);
    KrHandle Complexes(std::vector<krnumer::Complex> values);
    KrHandle Integers(std::vector<int32_t> values);
    KrHandle Bytes(std::vector<uint8_t> values);
    KrHandle Matrix(int32_t rows, int32_t columns, std::vector<double> values);
    KrHandle ComplexMatrix(int32_t rows, int32_t columns, std::vector<krnumer::Complex> values);
    KrHandle IntegerMatrix(int32_t rows, int32_t columns, std::vector<int32_t> values);
    KrHandle Cube(int32_t pages, int32_t rows, int32_t columns, std::vector<double> values);
    template <class Record>
    KrHandle Records(const std::vector<Record>& records) {
        return NewRecords(sizeof(Record), static_cast<int32_t>(records.size()), records.data());
    }

    // Outputs, with other contents and another size than the call will give them.
    KrHandle OutDoubles(OnFailure on_failure = OnFailure::kEmptied);
    KrHandle OutComplexes(OnFailure on_failure = OnFailure::kEmptied);
    KrHandle OutIntegers(OnFailure on_failure = OnFailure::kEmptied);
    KrHandle OutMatrix(OnFailure on_failure = OnFailure::kEmptied);
    KrHandle OutComplexMatrix(OnFailure on_failure = OnFailure::kEmptied);
    KrHandle OutIntegerMatrix(OnFailure on_failure = OnFailure::kEmptied);

    // An input above that the call replaces.
    KrHandle Replaced(KrHandle input, OnFailure on_failure = OnFailure::kEmptied);

    // Scalar outputs of doubles. Numbers gives several in a row, as in a record.
    double* Number(OnFailure on_failure = OnFailure::kEmptied) { return Numbers(1, on_failure); }
    double* Numbers(int32_t count, OnFailure on_failure = OnFailure::kEmptied);
    KrComplex* ComplexNumber(OnFailure on_failure = OnFailure::kEmptied) {
        return reinterpret_cast<KrComplex*>(Numbers(2, on_failure));
    }
    // A scalar in or out that is only compared between passes.
    int32_t* Integer(int32_t value);
    double* State(double value);

    // The cell of *err, holding garbage. Asking for it makes the scene one whose status is delivered there.
    int32_t* err();

    // Some allocations only serve a convenience: without them the call still succeeds, with other results.
    void SurvivesRefusedAllocation() { survives_refusal_ = true; }

    // The status of a call whose memory is refused, where it is not -20001.
    void RefusalGives(int32_t status) { refusal_status_ = status; }

    // The call fails even undisturbed, by this status: what it stands for is not provided.
    void AlwaysGives(int32_t status) { undisturbed_status_ = status; }

    // A refused resize is no failure of the call, which does without.
    void SurvivesRefusedResize() { survives_resize_ = true; }

    // Calls the export, under the pressure of this pass.
    template <class Return, class... Parameters, class... Arguments>
    int32_t Call(Return (*function)(Parameters...), Arguments&&... arguments) {
        std::tuple<Parameters...> varied{Varied<Parameters>(arguments)...};
        return Call([&] {
            if constexpr (std::is_void_v<Return>) {
                std::apply(function, varied);
                return krnumer::kOk;
            } else {
                return std::apply(function, varied);
            }
        });
    }

    // Makes several calls that belong together.
    template <class Function>
    int32_t Call(Function&& function) {
        int32_t result;
        {
            const ArmedAllocator armed(refused_allocation_);
            result = function();
        }
        result_ = result;
        status_ = err_asked_ ? err_ : result;
        return status_;
    }

    int32_t status() const { return status_; }
    int32_t result() const { return result_; }
    bool survives_refusal() const { return survives_refusal_; }
    bool survives_resize() const { return survives_resize_; }
    int32_t undisturbed_status() const { return undisturbed_status_; }
    int32_t refusal_status() const { return refusal_status_; }

    // The outputs, printable and comparable to the bit.
    std::string Results() const;
    // What an output holds although it should be in its failure state; empty when all are.
    std::string NotCleared() const;

  private:
    struct Array {
        KrHandle handle;
        int32_t type_code;
        bool output;
        OnFailure on_failure;
    };
    struct Scalars {
        std::vector<double> values;
        bool output;
        OnFailure on_failure;
    };

    // The argument as the function is to see it. Constants behind pointers are varied as copies, arrays of them whole.
    template <class Parameter, class Argument>
    Parameter Varied(Argument& argument) {
        using Pointee = std::remove_pointer_t<Parameter>;
        if constexpr (std::is_same_v<Parameter, KrHandle>) {
            return variation_ == nullptr ? KrHandle{argument} : Alias(argument);
        } else if constexpr (std::is_arithmetic_v<Parameter>) {
            const auto value = static_cast<Parameter>(argument);
            return variation_ == nullptr ? value : variation_->Of(value);
        } else if constexpr (std::is_const_v<Pointee> && std::is_arithmetic_v<Pointee>) {
            if (variation_ == nullptr) return argument;
            using Value = std::remove_const_t<Pointee>;
            constexpr size_t kCount = std::is_array_v<Argument> ? std::extent_v<Argument> : 1;
            const auto copies = std::make_shared<std::array<Value, kCount>>();
            const Pointee* values = argument;
            if (values == nullptr) return nullptr;
            for (Value& copy : *copies) copy = variation_->Of(*values++);
            kept_.push_back(copies);
            return copies->data();
        } else {
            return argument;
        }
    }
    // Now and then another array of the kind, so that the call meets one array twice.
    KrHandle Alias(KrHandle handle);

    KrHandle NewArray(int32_t type_code, std::vector<int32_t> dimensions, const void* elements);
    KrHandle NewRecords(int32_t bytes, int32_t count, const void* elements);
    KrHandle NewOutput(int32_t type_code, int rank, OnFailure on_failure);
    KrHandle Keep(KrHandle handle, int32_t type_code);

    std::vector<Array> arrays_;
    std::vector<Scalars*> scalars_;
    std::vector<int32_t*> integers_;
    std::vector<std::shared_ptr<void>> kept_;
    int32_t err_ = 0x5A5A5A5A;
    bool err_asked_ = false;
    bool survives_refusal_ = false;
    bool survives_resize_ = false;
    int32_t undisturbed_status_ = krnumer::kOk;  // or a warning
    int32_t refusal_status_ = krnumer::kOutOfMemory;
    int32_t refused_allocation_ = 0;
    Variation* variation_ = nullptr;  // null: arguments as the scene gives them
    Malformed* malformed_ = nullptr;
    int32_t result_ = 0;
    int32_t status_ = 0;
};

using Play = int32_t (*)(Scene&);

struct Entry {
    std::string export_name;
    std::string scene_name;  // the export's name, with a suffix where an export has several scenes
    Play play;
};

// All scenes, in no order.
std::vector<Entry>& Entries();

struct Registration {
    Registration(const char* export_name, const char* scene_name, Play play) {
        Entries().push_back({export_name, scene_name, play});
    }
};

}  // namespace sweep

#define SWEEP_NAMED(name, variant)                                                             \
    static int32_t variant##_scene(sweep::Scene& scene);                                       \
    static const sweep::Registration variant##_registration{#name, #variant, variant##_scene}; \
    static int32_t variant##_scene([[maybe_unused]] sweep::Scene& scene)

// One scene of an export.
#define SWEEP(name) SWEEP_NAMED(name, name)
// A further scene: SWEEP_MORE(ScaledWinH, computed) { ... }
#define SWEEP_MORE(name, suffix) SWEEP_NAMED(name, name##_##suffix)
