#include "Naming/HX_NamingFixture.h"
#include "platform/datatypes/HX_NumericalType.h"

namespace {

using testing::IsEmpty;
using testing::StartsWith;

class MacrosTest : public HX_NamingFixture {};

TEST_F(MacrosTest, EverySingleLetterMacroObeysItsBits) {
  struct Row {
    const char* macro;
    unsigned int bit;
    const char* value;        // for the block "Speed Gain"
    const char* placeholder;  // for nothing at all
    bool changes;
  };
  const Row rows[] = {
      {"$L", 0x1, "Speed_Gain", "", false},
      {"$B", 0x2, "Speed_Gain", "_B", false},
      {"$S", 0x4, "Sa3", "_S", true},
      {"$I", 0x8, "a", "", false},
      {"$M", 0x10, "plant v2", "plant v2", false},
      {"$N", 0x20, "Ctrl", "Ctrl", false},
      {"$H", 0x40, "_H", "_H", false},
      {"$O", 0x80, "_O", "_O", false},
      {"$C", 0x100, "_C", "_C", false},
      {"$T", 0x400, "_T", "_T", false},
      {"$X", 0x800, "_X", "_X", false},
      {"$R", 0x1000, "", "", true},
      {"$(Type)", 0x80000, "__Type_", "__Type_", false},
      {"$(BaseType)", 0x80000, "__BaseType_", "__BaseType_", false},
  };
  const HxCSrcRef* block = gain.getSrcRef();
  for (const Row& row : rows) {
    SCOPED_TRACE(row.macro);
    EXPECT_EQ(expand(row.macro, block), row.value);
    EXPECT_TRUE(complete);
    EXPECT_EQ(changeable, row.changes);
    EXPECT_EQ(expand(row.macro, nullptr), row.placeholder);
    EXPECT_EQ(expand(row.macro, block, nullptr, ~row.bit, ~row.bit), row.value);
    EXPECT_TRUE(complete);
    EXPECT_EQ(expand(row.macro, block, nullptr, row.bit), row.macro);
    EXPECT_FALSE(complete || changeable);
    EXPECT_EQ(expand(row.macro, block, nullptr, 0, row.bit), row.value);
    EXPECT_FALSE(complete);
  }
  EXPECT_THAT(messages(), IsEmpty());
}

TEST_F(MacrosTest, LabelsLoseBlanksAndOneEnclosingPairOfBrackets) {
  struct Row {
    const char* label;
    const char* result;
  };
  const Row rows[] = {{"  <speed> ", "speed"}, {"< a b >", "a_b"},
                      {"", "Speed_Gain"},      {" <> ", "Speed_Gain"},
                      {"a<b", "a_b"},          {"9", "_9"}};
  for (const Row& row : rows) {
    HxCCIdentifier id = identifier("$L", gain.getSrcRef());
    id.setSignalLabel(row.label);
    names.createNameFromForm(id, nullptr, 0, 0, false);
    EXPECT_EQ(formal(id), row.result) << row.label;
  }
}

TEST_F(MacrosTest, SystemNumbersReadAsSigned) {
  EXPECT_EQ(expand("$S", car.getSrcRef()), "Sr0");
  car.setSubsystem("r", 0x80000000U);
  EXPECT_EQ(expand("$S", car.getSrcRef()), "Sr0");
  car.setSubsystem("", 0x7FFFFFFFU);
  EXPECT_EQ(expand("$S", car.getSrcRef()), "S2147483647");
}

TEST_F(MacrosTest, ModelValuesKeepTheirCharactersWhereTheyAreNames) {
  event.setHierarchy("a.b");
  HxCCIdentifier id = identifier("$H$O$X", event.getStateflowSrcRef());
  id.setDollarXValue("x-y");
  names.createNameFromForm(id, nullptr, 0, 0, false);
  EXPECT_EQ(formal(id), "a.bgo_x-y");
}

TEST_F(MacrosTest, DataDictionaryNamesFallBackToWhatIdentifiesTheObject) {
  const HxCDdSrcRef known(HX_DdTree::instance().add("//DD0/Pool/K p"));
  const HxCDdSrcRef lost(4711);
  const HxCSrcRef* sf = event.getStateflowSrcRef();
  struct Row {
    const char* why;
    const HxCSrcRef* srcRef;
    const HxCSrcRef* ddRef;
    unsigned int retained;
    unsigned int provisional;
    const char* result;
    bool changes;
  };
  const Row rows[] = {
      {"object", sf, &known, 0, 0, "K p", false},
      {"unknown object", sf, &lost, 0, 0, "_D", false},
      {"no data dictionary reference", nullptr, sf, 0, 0, "_D", false},
      {"Stateflow object", sf, nullptr, 0, 0, "DD_Cc7_go_", true},
      {"retained macros count only for $D itself", sf, nullptr, 0x1FD, 0,
       "DD_Cc7_go_", true},
      {"block", gain.getSrcRef(), nullptr, 0, 0, "DD_Sa3_Speed_Gain", true},
      {"nothing", nullptr, nullptr, 0, 0, "_D", false},
      {"retained", sf, &known, 0x200, 0, "$D", false},
      {"provisional", sf, &known, 0x200, 0x200, "_D", false},
  };
  for (const Row& row : rows) {
    SCOPED_TRACE(row.why);
    HxCCIdentifier id = identifier("$D", row.srcRef);
    id.setDdSourceRef(row.ddRef);
    const bool final = names.createNameFromForm(id, nullptr, row.retained,
                                                row.provisional, false);
    EXPECT_EQ(formal(id), row.result);
    EXPECT_EQ(id.getIdentifierChangeable(HxCCIdentifier::eFormalName),
              row.changes);
    EXPECT_EQ(final, ((row.retained | row.provisional) & 0x200) == 0);
  }
  for (unsigned int retained : {0U, 0x200U}) {
    KyCXString result("x");
    EXPECT_EQ(HxCNamesTestAccess::ddObjectName(names, result, retained, 0x200),
              2);
    EXPECT_STREQ(result.cstring(), retained == 0 ? "x_DGain" : "x_D$D");
  }
}

class TypeMacrosTest : public HX_NamingFixture {
 protected:
  TypeMacrosTest() { base.setCut("i-16").setBase(); }

  HX_NumericalType isSigned{-9e18, 9e18, 64, true};
  HX_NumericalType isUnsigned{0, 9e18, 64, false};
  HX_DataType base{"Int 16"};
};

TEST_F(TypeMacrosTest, QuestionsAreAskedInTheirOrder) {
  HX_DataType bits("Bits");
  HX_DataType nameless("");
  const auto make = [](const char* name) {
    return std::make_unique<HX_DataType>(name);
  };
  struct Row {
    const char* why;
    std::unique_ptr<HX_DataType> type;
    const char* cut;
    const char* name;
    const char* baseName;
    HX_DataType* bitfieldBase = nullptr;
    std::size_t assertions = 0;
  };
  std::vector<Row> rows;
  const auto add = [&](const char* why, const char* cut, const char* name,
                       const char* baseName) -> Row& {
    rows.push_back({why, make("My-Type"), cut, name, baseName});
    return rows.back();
  };
  const char* const kUnknown = "_UnknownHXBaseType_";
  using Type = HX_DataType;
  add("base", "b", "My_Type", "My_Type").type->setCut("b").setBase();
  add("derived", "i-16", "My_Type", "Int_16").type->setDerivedFrom(&base);
  add("derived comes before base", "i-16", "My_Type", "Int_16")
      .type->setCut("b")
      .setBase()
      .setDerivedFrom(&base);
  add("derived from nothing", "", "My_Type", kUnknown)
      .type->setDerivedFrom(nullptr);
  add("array of a base", "i-16", "Int_16", "Int_16").type->setElement(&base);
  add("unnamed, without a name", "", "", "")
      .type->setUnnamed(Type::eUnnamedStruct, false)
      .setDerivedFrom(&base);
  add("second unnamed kind, with a name", "", "My_Type", "")
      .type->setUnnamed(Type::eUnnamedEnum, true);
  add("64 bit, signed", "I64", "My_Type", kUnknown)
      .type->set64BitInteger()
      .setNumerical(&isSigned);
  add("64 bit, unsigned", "U64", "My_Type", kUnknown)
      .type->set64BitInteger()
      .setNumerical(&isUnsigned);
  add("base comes before 64 bit", "b", "My_Type", "My_Type")
      .type->setCut("b")
      .setBase()
      .set64BitInteger();
  add("numerical with properties", "n", "My_Type", "Int_16")
      .type->setCut("n")
      .setNumerical(&isSigned)
      .setOrigin(&base);
  add("numerical over another type", "i-16", "My_Type", kUnknown)
      .type->setNumerical(&isSigned)
      .setUnderlyingType(&base);
  add("numerical over nothing", "", "My_Type", kUnknown)
      .type->setNumerical(&isSigned);
  Row& bitfield = add("bit field", "i-16", "My_Type", "Bits");
  bitfield.type->setBitfield().setDerivedFrom(&base);
  bitfield.bitfieldBase = &bits;
  add("bit field without a base", "i-16", "My_Type", kUnknown)
      .type->setBitfield()
      .setDerivedFrom(&base);
  Row& unnamedBase =
      add("bit field over a nameless type", "i-16", "My_Type", kUnknown);
  unnamedBase.type->setBitfield().setDerivedFrom(&base);
  unnamedBase.bitfieldBase = &nameless;
  add("no kind at all", "", "", "").assertions = 3;

  for (const Row& row : rows) {
    SCOPED_TRACE(row.why);
    clearMessages();
    types.getBaseServer()->setBitfieldBaseType(row.bitfieldBase);
    EXPECT_EQ(expand("$T", nullptr, row.type.get()), row.cut);
    EXPECT_EQ(expand("$(Type)", nullptr, row.type.get()), row.name);
    EXPECT_EQ(expand("$(BaseType)", nullptr, row.type.get()), row.baseName);
    EXPECT_EQ(messages().size(), row.assertions);
    for (const std::string& message : messages())
      EXPECT_THAT(message, StartsWith("7/3 "));
  }
}

}  // namespace
