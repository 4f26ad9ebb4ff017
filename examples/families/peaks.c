/* The peaks of a tone that comes in two blocks: where they are between the samples, and how high. */
#include <math.h>
#include "arrays.h"

int main(void) {
    enum { block = 32 };
    KrPeakRecord record = {.width = 5, .threshold = 0.5, .polarity = KRN_PEAKS};
    KrPeakState detector;
    KrHandle work = NULL;
    record.input = KrrtNewArray(KRRT_DOUBLE, block);
    record.locations = Empty(), record.amplitudes = Empty(), record.second_derivatives = Empty();

    for (int turn = 0; turn < 2; ++turn) {
        int32_t err;
        for (int i = 0; i < block; ++i) Elements(record.input)[i] = sin(0.3 * (turn * block + i));
        record.flags = turn == 0 ? KRN_FIRST_BLOCK : KRN_LAST_BLOCK;
        PeakD(&record, &detector, &work, &err), Check(err);
        for (int32_t k = 0; k < record.count; ++k)
            printf("block %d: %.3f at %.2f\n", turn, Elements(record.amplitudes)[k], Elements(record.locations)[k]);
    }
    FREE(record.input, record.locations, record.amplitudes, record.second_derivatives);
    return 0;
}
