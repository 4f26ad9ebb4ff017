/*
 * Linear algebra in real and complex arithmetic.
 *
 * A matrix is a 2-D array of rows and columns, row after row; a vector is a 1-D array. Real functions take arrays of
 * doubles, complex ones (most are named Cx...) arrays of KrComplex, and the two do the same unless stated otherwise.
 *
 * A packed triangle of order n is a 1-D array of n(n+1)/2 elements, column by column, each column holding only its
 * part of the triangle: in the lower form from the diagonal down, in the upper form from the top to the diagonal.
 *
 * A failure leaves array outputs empty, arrays that are input and output in one included, and scalar outputs NaN.
 */
#ifndef KRNUMER_LINALG_H
#define KRNUMER_LINALG_H

#include <krnumer/linalg_basic.h>
#include <krnumer/linalg_eigen.h>
#include <krnumer/linalg_equations.h>
#include <krnumer/linalg_factor.h>
#include <krnumer/linalg_function.h>
#include <krnumer/linalg_inverse.h>
#include <krnumer/linalg_measures.h>
#include <krnumer/linalg_schur.h>
#include <krnumer/linalg_solve.h>
#include <krnumer/linalg_svd.h>

#endif
