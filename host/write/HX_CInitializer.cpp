#include "host/write/HX_CInitializer.h"

#include <algorithm>
#include <cmath>
#include <cstdint>

#include "Math/FPS_FloatingPointSupport.h"
#include "host/write/HX_CText.h"

namespace {

// Of doubles up to 2^64; 2^64 itself gives the largest integer below.
std::uint64_t bitsOf64(double value, bool isSigned) {
  if (isSigned || value < 9223372036854775808.0)
    return static_cast<std::uint64_t>(FPS_SatCastToInt64(value));
  return value >= 18446744073709551616.0 ? UINT64_MAX
                                         : static_cast<std::uint64_t>(value);
}

// The number of an enumeration constant is checked when the document is read.
std::string constantOf(const HX_TypeItem& type, double value) {
  for (const HX_TypeItem::Constant& constant : type.values)
    if (constant.value == value) return constant.name;
  return "0";
}

std::string literalOf(const HX_TypeItem& type, double value) {
  if (type.kind == HX_TypeKind::eEnum) return constantOf(type, value);
  const bool isSigned = type.numerical->isSigned();
  if (type.cType == HX_CType::eFloat)
    return HX_FloatText(static_cast<float>(value));
  if (type.isFloating()) return HX_DoubleText(value);
  if (type.kind == HX_TypeKind::eInteger64)
    return HX_WordsText(bitsOf64(value, isSigned), isSigned);
  if (isSigned) return HX_SignedText(FPS_SatCastToInt(value));
  return std::to_string(FPS_SatCastToULong(value)) + "U";
}

}  // namespace

HX_CInitializer::HX_CInitializer(const HX_FormedName& name)
    : m_Wanted(*name.wanted) {
  append(*m_Wanted.type);
}

void HX_CInitializer::append(const HX_TypeItem& type) {
  if (type.kind == HX_TypeKind::eArray) {
    m_Text += '{';
    for (int i = 0; i < type.length && (i == 0 || hasValue()); ++i) {
      if (i > 0) m_Text += ", ";
      append(*type.of);
    }
    m_Text += '}';
  } else if (type.kind == HX_TypeKind::eStruct) {
    const char* before = "{";
    for (const HX_TypeItem::Field& field : type.fields) {
      m_Text += before;
      append(*field.type);
      before = ", ";
    }
    m_Text += '}';
  } else if (type.of != nullptr) {
    append(*type.of);
  } else {
    appendScalar(type);
  }
}

void HX_CInitializer::appendScalar(const HX_TypeItem& type) {
  double value = 0;
  if (hasValue()) {
    const double physical = m_Wanted.initial[m_At++];
    value = type.numerical ? stepsOf(type, physical) : physical;
  }
  m_Text += literalOf(type, value);
}

double HX_CInitializer::stepsOf(const HX_TypeItem& type, double physical) {
  const HX_NumericalType& range = *type.numerical;
  const double steps = (physical - m_Wanted.zero) / m_Wanted.lsb;
  // From 2^53 on every double is an integer.
  const bool isRounded = !type.isFloating() && std::fabs(steps) < 0x1p53;
  const double wanted = isRounded ? FPS_Round(steps) : steps;
  const double value =
      std::clamp(wanted, range.getMinimum(), range.getMaximum());
  if (value != wanted) m_Unfit.push_back(physical);
  return value;
}
