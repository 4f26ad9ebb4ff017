#include "measure/store.h"

#include "frame/status.h"

namespace krnumer::measure {

int32_t Context::Fetch(const Parameters& parameters, Kind kind, const Signal& signal, Reading* reading) {
    const std::lock_guard lock(mutex_);
    if (!(signal.dt() > 0.0)) return kBadMeasurementInterval;
    if (signal.count() < 1) return kNoSamples;
    graph_.Use(parameters);
    return graph_.Evaluate(kind, signal, reading);
}

void Context::Clear() {
    const std::lock_guard lock(mutex_);
    graph_.Clear();
}

uint32_t Store::Create() {
    auto context = std::make_shared<Context>();
    const std::lock_guard lock(mutex_);
    uint32_t id = next_id_;
    while (!contexts_.try_emplace(id, context).second) id = After(id);
    next_id_ = After(id);
    return id;
}

std::shared_ptr<Context> Store::Find(uint32_t id) {
    const std::lock_guard lock(mutex_);
    const auto found = contexts_.find(id);
    return found != contexts_.end() ? found->second : nullptr;
}

std::shared_ptr<Context> Store::Remove(uint32_t id) {
    const std::lock_guard lock(mutex_);
    const auto node = contexts_.extract(id);
    return node ? node.mapped() : nullptr;
}

}  // namespace krnumer::measure
