// Archives and parts that are broken or hostile: one line with part and place.
#include <zip.h>

#include "import/HX_ImportTest.h"

using testing::HasSubstr;
using testing::StartsWith;

namespace {

class ArchiveTest : public HX_ImportTest {
 protected:
  // Names of parts stand twice in an archive, and no checksum covers names.
  std::string importRenamed(const std::string& from, const std::string& to) {
    Parts parts = modelWith("");
    parts[from] = "text";
    const auto file = pack("m.slx", parts);
    std::string bytes = read(file);
    for (std::size_t at = bytes.find(from); at != std::string::npos;
         at = bytes.find(from, at + 1))
      bytes.replace(at, from.size(), to);
    write(file, bytes);
    return import(file).document;
  }
};

TEST_F(ArchiveTest, FilesThatAreNoModelAreRefused) {
  write(m_Folder / "old.mdl", "Model {\n}");
  write(m_Folder / "old.slx", "Model {\n}");
  write(m_Folder / "noise.slx", std::string(300, 'x'));
  write(m_Folder / "empty.slx", "");
  std::filesystem::create_directory(m_Folder / "folder.slx");
  const std::string textForm =
      ": the text form of models (.mdl) is not read; open the model where it "
      "was made and save it as .slx";
  EXPECT_EQ("old.mdl" + textForm, import(m_Folder / "old.mdl").document);
  EXPECT_EQ("old.slx" + textForm, import(m_Folder / "old.slx").document);
  for (const std::string file : {"noise.slx", "empty.slx"})
    EXPECT_THAT(import(m_Folder / file).document,
                StartsWith(file + ": expected a zip archive: "));
  for (const std::string file : {"folder.slx", "absent.slx"})
    EXPECT_EQ(file + ": expected a file that can be read",
              import(m_Folder / file).document);
}

TEST_F(ArchiveTest, EachCutAndEachFlippedBitIsRefusedOrHarmless) {
  const auto file = pack("m.slx", partsOf("climate_types"));
  const std::string whole = read(file);
  m_Request.dictionaries = {file};
  const auto model = pack("model.slx", modelWith(""));
  const std::string good = import(model).document;
  ASSERT_THAT(good, StartsWith("{"));
  for (std::size_t size = 0; size < whole.size(); size += 7) {
    write(file, whole.substr(0, size));
    EXPECT_THAT(import(model).document, StartsWith("m.slx: ")) << size;
  }
  for (std::size_t at = 0; at < whole.size(); at += 3) {
    std::string bytes = whole;
    bytes[at] = static_cast<char>(bytes[at] ^ 16);
    write(file, bytes);
    const std::string result = import(model).document;
    EXPECT_THAT(result, testing::AnyOf(good, StartsWith("m.slx: "))) << at;
  }
}

TEST_F(ArchiveTest, NamesThatLeadOutsideAreRefused) {
  for (const std::string to :
       {"../abc", "/a/abc", "a/../b", "C:/abc", "a\\../b"})
    EXPECT_EQ("m.slx: " + to + ": the name leads outside the archive",
              importRenamed("aaaaaa", to));
  EXPECT_THAT(importRenamed("aaaaaa", "a..b/c"), StartsWith("{"));
  EXPECT_EQ(
      "m.slx: simulink/blockdiagram.xml: the archive holds two parts of "
      "this name",
      importRenamed("simulink/blockdiagram_xml", "simulink/blockdiagram.xml"));
  // A reference to a part cannot leave the folder of systems either.
  EXPECT_EQ(
      "m.slx: simulink/systems/../../../etc/passwd.xml: the part is "
      "missing",
      importParts({{"simulink/blockdiagram.xml",
                    "<ModelInformation><Model><System "
                    "Ref='../../../etc/passwd'/></Model>"
                    "</ModelInformation>"}})
          .document);
}

TEST_F(ArchiveTest, LimitsHoldFromBothSides) {
  Parts parts = modelWith("");
  parts["big.bin"] = std::string(5000, 'x');  // packs to less than 50 bytes
  const auto size = parts["simulink/blockdiagram.xml"].size();
  const struct {
    const char* why;
    std::uint64_t HX_ImportLimits::*limit;
    std::uint64_t least;  // accepted
    std::string reason;
  } rows[] = {
      {"parts", &HX_ImportLimits::parts, 2, "2 parts, expected at most 1"},
      {"size", &HX_ImportLimits::partSize, 5000,
       "big.bin: 5000 bytes, expected at most 4999"},
      {"sum", &HX_ImportLimits::totalSize, 5000 + size,
       "unpacks to more than " + std::to_string(5000 + size - 1) + " bytes"},
      {"small parts may be packed well", &HX_ImportLimits::ratioFrom, 5000,
       "big.bin: packed more than 10 to 1, which no model is"},
  };
  for (const auto& row : rows) {
    SCOPED_TRACE(row.why);
    m_Request.limits = {};
    m_Request.limits.ratio = 10;
    m_Request.limits.*row.limit = row.least;
    EXPECT_THAT(importParts(parts).document, StartsWith("{"));
    --(m_Request.limits.*row.limit);
    EXPECT_EQ("m.slx: " + row.reason, importParts(parts).document);
  }
}

std::string repeated(int count, const std::string& text) {
  std::string all;
  for (int i = 0; i < count; ++i) all += text;
  return all;
}

TEST_F(ArchiveTest, DepthAndNumberOfBlocksAreLimited) {
  const std::string open = "<Block BlockType='SubSystem' Name='s'><System>";
  const auto nest = [&](int depth) {
    return modelWith(repeated(depth, open) +
                     repeated(depth, "</System></Block>"));
  };
  m_Request.limits.depth = 30;
  EXPECT_THAT(importParts(nest(30)).document, StartsWith("{"));
  EXPECT_EQ("m.slx: systems nested deeper than 30",
            importParts(nest(31)).document);
  EXPECT_THAT(importParts(nest(200000)).document, StartsWith("m.slx: "));

  m_Request.limits = {};
  m_Request.limits.blocks = 30;
  EXPECT_THAT(importParts(nest(30)).document, StartsWith("{"));
  EXPECT_EQ("m.slx: more than 30 blocks with references expanded",
            importParts(nest(31)).document);

  // Each library doubles the blocks of the next: small files, a large tree.
  m_Request.limits.blocks = 10000;
  for (int i = 0; i < 40; ++i) {
    const std::string next = std::to_string(i + 1);
    const std::string link =
        "' SID='1'><P Name='ModelNameDialog'>d" + next + "</P></Block>";
    pack("d" + std::to_string(i) + ".slx",
         modelWith("<Block BlockType='ModelReference' Name='a" + link +
                   "<Block BlockType='ModelReference' Name='b" + link));
  }
  EXPECT_THAT(import(m_Folder / "d0.slx").document,
              HasSubstr("more than 10000 blocks"));
  m_Request.limits.depth = 30;
  EXPECT_THAT(import(m_Folder / "d0.slx").document,
              HasSubstr(".slx: systems nested deeper than 30"));
}

TEST_F(ArchiveTest, StatesAreLimitedInDepth) {
  Parts parts = modelWith(
      "<Block BlockType='SubSystem' Name='c'><P Name='SFBlockType'>Chart</P>"
      "</Block>");
  const auto chart = [&](int depth) {
    parts["simulink/stateflow.xml"] =
        "<Stateflow><machine><Children><chart id='1'><P Name='name'>c</P>" +
        repeated(depth, "<Children><state SSID='1'>") +
        repeated(depth, "</state></Children>") +
        "</chart></Children></machine></Stateflow>";
    return parts;
  };
  m_Request.limits.depth = 30;
  EXPECT_THAT(importParts(chart(29)).document, StartsWith("{"));
  EXPECT_EQ("m.slx: systems and states nested deeper than 30 in c",
            importParts(chart(30)).document);
}

TEST_F(ArchiveTest, BrokenPartsAreRefusedWithTheirPlace) {
  const std::string part = "simulink/blockdiagram.xml";
  const struct {
    const char* text;
    const char* reason;
  } rows[] = {
      {"<ModelInformation>\n <Model>\n</ModelInformation>",
       ":3:3: expected well-formed XML: Start-end tags mismatch"},
      {"", ":1:1: expected well-formed XML: No document element found"},
      {"<a>\n\xC3(</a>", ":2:1: expected text in UTF-8"},
      {"<!DOCTYPE a [<!ENTITY x SYSTEM 'file:///etc/passwd'>]><a>&x;</a>",
       ": expected no document type (<!DOCTYPE>)"},
      {"<other/>",
       ": expected the root element <ModelInformation>, found <other>"},
      {"<ModelInformation/>",
       ": expected one of the elements <Model>, <Library>, <Subsystem> in "
       "<ModelInformation>"},
  };
  for (const auto& row : rows)
    EXPECT_EQ("m.slx: " + part + row.reason,
              importParts({{part, row.text}}).document);
  EXPECT_EQ("m.slx: " + part + ":1:3: expected text, found a zero byte",
            importParts({{part, std::string("<a\0>", 4)}}).document);
  EXPECT_EQ("m.slx: " + part + ": the part is missing",
            importParts({{"readme.txt", "none"}}).document);
}

TEST_F(ArchiveTest, EncryptedPartsAreRefused) {
  const auto file = pack("m.slx", modelWith(""), [](zip_t* archive) {
    zip_file_set_encryption(archive, 0, ZIP_EM_AES_256, "secret");
  });
  EXPECT_EQ("m.slx: simulink/blockdiagram.xml: the part is encrypted",
            import(file).document);
}

}  // namespace
