// The natural logarithm of this library: correctly rounded, so that every
// machine, compiler and word length gives the same bits.
//
// The logarithms of C run-times differ in the last bit from each other, and one
// run-time differs from itself on processors with other instructions; no result
// that depends on them could be the same everywhere. A correctly rounded result
// is unique; a good run-time gives it too in all but one case of a thousand.
//
// Method: table-driven reduction and polynomial with an error bound, followed
// by Ziv's rounding test; the few arguments that fail the test are computed
// again in 256-bit fixed point. P. T. P. Tang, "Table-driven implementation of
// the logarithm function in IEEE floating-point arithmetic", ACM TOMS 16
// (1990); A. Ziv, "Fast evaluation of elementary mathematical functions with
// correctly rounded last bit", ACM TOMS 17 (1991); worst cases: V. Lefevre,
// J.-M. Muller, "Worst cases for correct rounding of the elementary functions
// in double precision", ARITH-15 (2001).

#ifndef MATH_IMPLMATH_HX_NATURALLOG_H
#define MATH_IMPLMATH_HX_NATURALLOG_H

/// ln(x), rounded to nearest. Minus infinity for both zeros, a NaN below zero
/// and for a NaN, infinity for infinity. Leaves errno alone. Needs
/// round-to-nearest.
double HX_NaturalLog(double x);

/// The same for a finite x above 0, always in fixed point: slow.
double HX_NaturalLogInFixedPoint(double x);

#endif  // MATH_IMPLMATH_HX_NATURALLOG_H
