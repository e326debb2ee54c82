// Runs hx_codegen as a user does.

#ifndef HOST_HX_HOSTPROGRAM_H
#define HOST_HX_HOSTPROGRAM_H

#include <filesystem>
#include <nlohmann/json.hpp>
#include <string>

struct HX_ProgramResult {
  int code;
  std::string out;
  std::string err;
};

std::string HX_ReadText(const std::filesystem::path& path);
void HX_WriteText(const std::filesystem::path& path, const std::string& text);

/// Runs a shell command with its output caught.
HX_ProgramResult HX_RunCommand(const std::string& command);
HX_ProgramResult HX_RunCodegen(const std::string& arguments);
/// Writes a document into the scratch folder and gives its path.
std::string HX_WriteModel(const nlohmann::json& model);

/// The parsed demo model.
nlohmann::json HX_DemoModel();
/// The smallest document: a block, two types and no names.
nlohmann::json HX_SmallModel();

/// The rows of a table in this folder, one line each.
nlohmann::json HX_CaseTable(const std::string& file);

/// A folder of its own for each test, empty at the start.
std::filesystem::path HX_ScratchFolder();

#endif  // HOST_HX_HOSTPROGRAM_H
