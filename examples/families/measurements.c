/* A pulse train of 5 V with slanted edges, a sample every microsecond. */
#include <krnumer/krnumer.h>
#include <stdio.h>

int main(void) {
    enum { period = 50, n = 200 };
    double samples[n];
    for (int i = 0; i < n; ++i) {
        const int t = (i + 40) % period; /* up in 5 samples, high for 15, down in 10, low for 20 */
        samples[i] = t < 5 ? t : t < 20 ? 5.0 : t < 30 ? 5.0 - 0.5 * (t - 20) : 0.0;
    }

    const struct {
        const char* name;
        int32_t selector;
        const char* unit;
    } wanted[] = {{"amplitude", KRN_AMPLITUDE, " V"},         {"period", KRN_PERIOD, " us"},
                  {"rise time", KRN_RISE_TIME, " us"},        {"fall time", KRN_FALL_TIME, " us"},
                  {"pulse width", KRN_POSITIVE_WIDTH, " us"}, {"duty cycle", KRN_DUTY_HIGH, ""}};
    const KrLevels levels = {90.0, 50.0, 10.0, KRN_LEVELS_PERCENT};
    const KrStateMethod method = {KRN_STATES_BY_HISTOGRAM, 500};
    uint32_t id;
    if (measurements_create(&id) != KRN_OK) return 1;
    for (int i = 0; i < 6; ++i) {
        double value;
        KrMarkers markers;
        const int32_t status = measurements_fetch((int32_t)id, wanted[i].selector, &levels, &method, 1, 0.0, 1.0,
                                                  samples, n, &value, &markers);
        if (status != KRN_OK) return 1;
        printf("%-11s %6.2f%s\n", wanted[i].name, value, wanted[i].unit);
    }
    return measurements_destroy((int32_t)id) == KRN_OK ? 0 : 1;
}
