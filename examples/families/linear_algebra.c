/* Equations and how far to trust their solution, least squares, eigenvalues, and a matrix without inverse. */
#include "arrays.h"

int main(void) {
    KrHandle a = NewMatrix(3, 3, (double[]){4, 1, 0, 1, 3, 1, 0, 1, 2}), b = DOUBLES(6, 10, 8), x = Empty();
    KrHandle tall = NewMatrix(4, 2, (double[]){1, 0, 1, 1, 1, 2, 1, 3}), y = DOUBLES(1.1, 2.9, 5.2, 6.8);
    KrHandle values = Empty(), singular = NewMatrix(2, 2, (double[]){1, 2, 2, 4});
    const int32_t twoNorm = 0, withVectors = 1;
    double condition;
    int32_t err;

    EqsByLUDri_head(a, b, x, &err), Check(err);
    Print("solution", x);
    CondNumber_head(a, &twoNorm, &condition, &err), Check(err);
    printf("condition number: %.4f\n", condition);
    GenLinEqs_head(tall, y, x, &err), Check(err);
    Print("least squares", x);
    SymEvectorEvalue_head(a, &withVectors, values, &err), Check(err);
    Print("eigenvalues", values);

    InvMatrixLUDri_head(singular, &err);
    printf("inverse of a singular matrix: status %d, %d elements\n", (int)err, (int)KrrtSize(singular, 0));
    FREE(a, b, x, tall, y, values, singular);
    return 0;
}
