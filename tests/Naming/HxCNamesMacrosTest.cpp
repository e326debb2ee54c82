#include <map>
#include <utility>

#include "Naming/HX_NamingFixture.h"
#include "platform/datatypes/HX_NumericalType.h"

namespace {

using testing::AllOf;
using testing::Each;
using testing::IsEmpty;
using testing::SizeIs;
using testing::StartsWith;

class MacrosTest : public HX_NamingFixture {};

TEST_F(MacrosTest, EverySingleLetterMacroObeysItsBits) {
  struct Row {
    const char* macro;
    unsigned int bit;
    const char *value, *placeholder;  // for "Speed Gain" and for no object
    bool changes = false;
  };
  const Row rows[] = {{"$L", 0x1, "Speed_Gain", ""},
                      {"$B", 0x2, "Speed_Gain", "_B"},
                      {"$S", 0x4, "Sa3", "_S", true},
                      {"$I", 0x8, "a", ""},
                      {"$M", 0x10, "plant v2", "plant v2"},
                      {"$N", 0x20, "Ctrl", "Ctrl"},
                      {"$H", 0x40, "_H", "_H"},
                      {"$O", 0x80, "_O", "_O"},
                      {"$C", 0x100, "_C", "_C"},
                      {"$T", 0x400, "_T", "_T"},
                      {"$X", 0x800, "_X", "_X"},
                      {"$R", 0x1000, "", "", true},
                      {"$(Type)", 0x80000, "__Type_", "__Type_"},
                      {"$(BaseType)", 0x80000, "__BaseType_", "__BaseType_"}};
  const HxCSrcRef* block = gain.getSrcRef();
  for (const Row& row : rows) {
    SCOPED_TRACE(row.macro);
    EXPECT_EQ(expand(row.macro, nullptr), row.placeholder);
    EXPECT_EQ(expand(row.macro, block, nullptr, ~row.bit, ~row.bit), row.value);
    EXPECT_TRUE(complete);
    EXPECT_EQ(changeable, row.changes);
    EXPECT_EQ(expand(row.macro, block, nullptr, row.bit), row.macro);
    EXPECT_FALSE(complete || changeable);
    EXPECT_EQ(expand(row.macro, block, nullptr, 0, row.bit), row.value);
    EXPECT_FALSE(complete);
  }
  EXPECT_THAT(messages(), IsEmpty());
}

TEST_F(MacrosTest, LabelsLoseBlanksAndOneEnclosingPairOfBrackets) {
  const std::pair<const char*, const char*> rows[] = {
      {"  <speed> ", "speed"}, {"< a b >", "a_b"}, {"", "Speed_Gain"},
      {" <> ", "Speed_Gain"},  {"a<b", "a_b"},     {"9", "_9"}};
  for (const auto& [label, result] : rows) {
    Id id = identifier("$L", gain.getSrcRef());
    id.setSignalLabel(label);
    EXPECT_EQ(expand(id), result) << label;
  }
}

TEST_F(MacrosTest, SystemNumbersReadAsSigned) {
  car.setSubsystem("r", 0x80000000U);
  EXPECT_EQ(expand("$S", car.getSrcRef()), "Sr0");
  car.setSubsystem("", 0x7FFFFFFFU);
  EXPECT_EQ(expand("$S", car.getSrcRef()), "S2147483647");
}

TEST_F(MacrosTest, ModelValuesKeepTheirCharactersWhereTheyAreNames) {
  event.setHierarchy("a.b");
  Id id = identifier("$H$O$X", event.getStateflowSrcRef());
  id.setDollarXValue("x-y");
  EXPECT_EQ(expand(id), "a.bgo_x-y");
}

TEST_F(MacrosTest, DataDictionaryNamesFallBackToWhatIdentifiesTheObject) {
  const HxCDdSrcRef known(HX_DdTree::instance().add("//DD0/Pool/K p"));
  const HxCDdSrcRef lost(4711);
  const HxCSrcRef* sf = event.getStateflowSrcRef();
  struct Row {
    const HxCSrcRef *srcRef, *ddRef;
    const char* result;
    unsigned int retained = 0, provisional = 0;
  };
  const Row rows[] = {
      {sf, &known, "K p"},
      {sf, &lost, "_D"},
      {nullptr, sf, "_D"},  // no data dictionary reference
      {nullptr, nullptr, "_D"},
      {sf, nullptr, "DD_Cc7_go_"},
      // Retained macros count only for $D itself.
      {sf, nullptr, "DD_Cc7_go_", 0x1FD},
      {gain.getSrcRef(), nullptr, "DD_Sa3_Speed_Gain", 0x6, 0x6},
      {sf, &known, "$D", 0x200},
      {sf, &known, "_D", 0x200, 0x200},
  };
  for (const Row& row : rows) {
    Id id = identifier("$D", row.srcRef);
    id.setDdSourceRef(row.ddRef);
    EXPECT_EQ(expand(id, nullptr, row.retained, row.provisional), row.result)
        << "row " << &row - rows;
    EXPECT_EQ(changeable, formal(id).size() > 3);
    EXPECT_EQ(complete, ((row.retained | row.provisional) & 0x200) == 0);
  }
  for (unsigned int retained : {0U, 0x200U}) {
    KyCXString result("x");
    EXPECT_EQ(HxCNamesTestAccess::ddObjectName(names, result, retained), 2);
    EXPECT_EQ(result, retained == 0 ? "x_DGain" : "x_D$D");
  }
}

using Type = HX_DataType;

HX_NumericalType isSigned{-9e18, 9e18, 64, true};
HX_NumericalType isUnsigned{0, 9e18, 64, false};

// What a word in a row below makes of a type.
const std::map<std::string, void (*)(Type& type, Type* base)> kWords = {
    {"struct",
     [](Type& t, Type*) { t.setUnnamed(Type::eUnnamedStruct, false); }},
    {"enum", [](Type& t, Type*) { t.setUnnamed(Type::eUnnamedEnum, true); }},
    {"derived", [](Type& t, Type* b) { t.setDerivedFrom(b); }},
    {"orphan", [](Type& t, Type*) { t.setDerivedFrom(nullptr); }},
    {"base", [](Type& t, Type*) { t.setCut("b").setBase(); }},
    {"array", [](Type& t, Type* b) { t.setElement(b); }},
    {"long", [](Type& t, Type*) { t.set64BitInteger(); }},
    {"signed", [](Type& t, Type*) { t.setNumerical(&isSigned); }},
    {"unsigned", [](Type& t, Type*) { t.setNumerical(&isUnsigned); }},
    {"own", [](Type& t, Type* b) { t.setCut("n").setOrigin(b); }},
    {"over", [](Type& t, Type* b) { t.setUnderlyingType(b); }},
    {"bits", [](Type& t, Type*) { t.setBitfield(); }}};

// Type -> its short, its long and its base's name.
const std::pair<const char*, const char*> kTypes[] = {
    {"struct derived", "||"},
    {"enum", "|My__Type|"},
    {"derived", "i-16|My__Type|Int__16"},
    {"base derived", "i-16|My__Type|Int__16"},
    {"orphan", "|My__Type|_UnknownHXBaseType_"},
    {"base", "b|My__Type|My__Type"},
    {"base long", "b|My__Type|My__Type"},
    {"array", "i-16|Int__16|Int__16"},
    {"long signed", "I64|My__Type|_UnknownHXBaseType_"},
    {"long unsigned", "U64|My__Type|_UnknownHXBaseType_"},
    {"signed own", "n|My__Type|Int__16"},
    {"signed over", "i-16|My__Type|_UnknownHXBaseType_"},
    {"signed", "|My__Type|_UnknownHXBaseType_"},
    {"derived bits", "i-16|My__Type|Bits"},
    {"", "||"}};

TEST_F(MacrosTest, TypesAreAskedWhatTheyAre) {
  Type base("Int  16"), bits("Bits"), nameless("");
  base.setCut("i-16").setBase();
  auto* server = types.getBaseServer();
  server->setBitfieldBaseType(&bits);
  const auto expandType = [&](const char* text) {
    Type type("My- Type");
    for (const auto& word : words(text)) kWords.at(word)(type, &base);
    return expand("$T|$(Type)|$(BaseType)", nullptr, &type);
  };
  for (const auto& [text, result] : kTypes) {
    EXPECT_THAT(messages(), IsEmpty());
    EXPECT_EQ(expandType(text), result) << text;
  }
  EXPECT_THAT(messages(), AllOf(SizeIs(3), Each(StartsWith("7/3 "))));
  for (HX_DataType* noBase : {static_cast<HX_DataType*>(nullptr), &nameless}) {
    server->setBitfieldBaseType(noBase);
    EXPECT_EQ(expandType("derived bits"), "i-16|My__Type|_UnknownHXBaseType_");
  }
}

}  // namespace
