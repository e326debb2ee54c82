#!/usr/bin/env python3
"""Prints the tables of src/Math/implMath/HX_NaturalLogTable.h.

The first has one row per interval of the mantissa z in [1, 2): a reciprocal of
at most 16 bits, its inverse "centre" near the interval's middle, which together
make (z - centre) * reciprocal exact or nearly so, and ln(centre) in two parts.

In the second, for arguments x near 1, the centre is the interval's middle and
the reciprocal has at most 10 bits, so that q = (x - centre) * reciprocal is
exact, as is the small rest of r = x * reciprocal - 1 = q + rest.
"""
from decimal import Decimal, getcontext
from fractions import Fraction

getcontext().prec = 60
GRID = 2**42  # the high parts are multiples of 2^-42
ROWS = 512
HALF_WIDTH = Fraction(1, 2 * ROWS)


def exact_ln(fraction):
    return Fraction((Decimal(fraction.numerator)
                     / Decimal(fraction.denominator)).ln())


def split(value):
    """value = high + low, high on the grid."""
    high = Fraction(round(value * GRID), GRID)
    return float(high), float(value - high)


def error_bound(reciprocal, centre, middle):
    """Bound of the error of r and its sums, in units of 2^-64."""
    largest = (HALF_WIDTH + abs(centre - middle)) * reciprocal
    skew = abs(centre * reciprocal - 1)  # since the inverse is rounded
    rounding = 1 if reciprocal.numerator.bit_length() > 11 else 0
    # From 2^-10 on the unit of rounding is twice as large; the series ends at
    # 2^-10 as well.
    excess = max(0.0, float(largest * 1024) - 1.0)
    return (float(largest * skew) * 2.0**64 + rounding
            + (1 + 20 * excess if excess > 0 else 0))


def row(index):
    middle = 1 + (2 * index + 1) * HALF_WIDTH
    candidates = []
    for bits in range(11, 17):
        nearest = round(2**bits / middle)
        for numerator in range(nearest - 8, nearest + 9):
            reciprocal = Fraction(numerator, 2**bits)
            centre = Fraction(float(1 / reciprocal))
            bound = error_bound(reciprocal, centre, middle)
            candidates.append((bound, reciprocal, centre))
    _, reciprocal, centre = min(candidates)
    return (float(reciprocal), float(centre), *split(exact_ln(centre)))


def rows_near_one():
    """The interval around 1 and its neighbours, 60 below and 34 above."""
    for index in range(-60, 35):
        centre = 1 + Fraction(index, 512 if index < 0 else 256)
        grid = 512 if index < 0 else 1024
        reciprocal = Fraction(round(grid / centre), grid)
        rest = centre * reciprocal - 1
        high, low = split(-exact_ln(reciprocal))
        yield float(reciprocal), float(rest), high + float(rest), low


def text(value):
    if value == 0:
        return "0.0"
    digits, exponent = value.hex().split("p")
    return digits.rstrip("0").rstrip(".") + "p" + exponent


def show(row):
    print("    {" + ", ".join(text(v) for v in row) + "},")


if __name__ == "__main__":
    print("    // ln 2:", *(text(v) for v in split(exact_ln(Fraction(2)))))
    for i in range(ROWS):
        show(row(i))
    print("    // near one")
    for near in rows_near_one():
        show(near)
