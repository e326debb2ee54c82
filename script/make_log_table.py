#!/usr/bin/env python3
"""Prints the table of src/Math/implMath/HX_NaturalLogTable.h.

One row per interval of the reduced argument z: the reciprocal of the interval's
middle, short enough to make products with it exact, and -ln of it in two parts.
"""
import re
from decimal import Decimal, getcontext
from fractions import Fraction

getcontext().prec = 60
GRID = 2**42  # the high parts are multiples of 2^-42


def split(value):
    """value = high + low, high on the grid."""
    high = Fraction(int((value * GRID).to_integral_value()), GRID)
    low = value - Decimal(high.numerator) / Decimal(high.denominator)
    return float(high), float(low)


def row(index):
    low, width = (Fraction(176 + index, 256), Fraction(1, 256))
    if low >= 1:
        low, width = (1 + Fraction(index - 80, 128), Fraction(1, 128))
    middle = low + width / 2
    grid = 256 if low < 1 else 512
    reciprocal = Fraction(round(grid / middle), grid)
    if index in (79, 80):  # next to 1 the argument itself is the best reduction
        reciprocal = Fraction(1)
    ln = -(Decimal(reciprocal.numerator) / Decimal(reciprocal.denominator)).ln()
    return (float(reciprocal), *split(ln))


def text(value):
    return re.sub(r"\.?0*p", "p", value.hex())


if __name__ == "__main__":
    print("    // ln 2:", *(text(v) for v in split(Decimal(2).ln())))
    for i in range(128):
        print("    {" + ", ".join(text(v) for v in row(i)) + "},")
