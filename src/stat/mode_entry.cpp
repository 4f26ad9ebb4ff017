#include "frame/entry.h"
#include "krnumer/stat.h"
#include "stat/mode.h"

using namespace krnumer;

int32_t ModeH(KrHandle x, int32_t intervals, KrHandle modes) {
    ByValue call;
    In<double> samples(call, x);
    Out<double> found(call, modes);
    Scratch<double> values;
    int32_t count = 0;
    int32_t status = call.Map();
    if (status == kOk) status = Mode(samples.data(), samples.size(), intervals, &values, &count);
    if (status < 0) return call.Fail(status);
    if (count < 1) return call.Leave(kOk);  // no mode: the array stays as it came
    if (auto host = found.Resize(count)) return call.Leave(host);
    found.Fill(values.data());
    return call.Deliver(kOk);
}
