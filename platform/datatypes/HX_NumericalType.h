// An integer type as the data type server describes it.
//
//   const HX_NumericalType int16(-32768.0, 32767.0, 16, true);

#ifndef PLATFORM_DATATYPES_HX_NUMERICALTYPE_H
#define PLATFORM_DATATYPES_HX_NUMERICALTYPE_H

/// Immutable. The server's own types may answer the queries otherwise.
class HX_NumericalType {
 public:
  /// \param minimum, maximum  the closed range of the values.
  /// \param bitWidth  the sign bit included.
  HX_NumericalType(double minimum, double maximum, int bitWidth, bool isSigned)
      : m_Minimum(minimum),
        m_Maximum(maximum),
        m_BitWidth(bitWidth),
        m_IsSigned(isSigned) {}
  virtual ~HX_NumericalType() = default;

  /// The closed range, the bits with the sign bit, the signedness.
  virtual double getMaximum() const { return m_Maximum; }
  virtual double getMinimum() const { return m_Minimum; }
  virtual int getBitWidth() const { return m_BitWidth; }
  virtual bool isSigned() const { return m_IsSigned; }

 private:
  double m_Minimum;
  double m_Maximum;
  int m_BitWidth;
  bool m_IsSigned;
};

#endif  // PLATFORM_DATATYPES_HX_NUMERICALTYPE_H
