// Generates what the ICode generation is measured on: test suites of global declarations and
// functions of every supported form, and host configurations with many typedefs and data
// dictionary variables.
#pragma once

#include "ItfSuiteGenerator.h"

#include <string>
#include <vector>

// `files` files of `blocksPerFile` blocks each; a block declares globals of every form, an
// iteration context, a prototype and its definition with parameters and locals, a static
// function and `ddPerBlock` data dictionary variables "DD_var<n>".
std::vector<ItfGeneratedFile> generateDeclarationSuite(int files, int blocksPerFile,
                                                       int ddPerBlock);
// The embedded default configuration plus `typedefs` typedefs ("tdef_<n>", under
// "/Pool/Typedefs/Bulk") and `ddVariables` data dictionary variables "DD_var<n>" (sint16,
// under "/Pool/Variables"), as a JSON document.
std::string generateHostConfig(int typedefs, int ddVariables);
