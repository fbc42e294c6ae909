// Generates large test suites for measuring the front end: every construct of the language,
// annotations included, repeated with fresh names.
#pragma once

#include <string>
#include <vector>

struct ItfGeneratedFile {
    std::string name;
    std::string text;
};

// `files` files of at least `linesPerFile` lines each.
std::vector<ItfGeneratedFile> generateSuite(int files, int linesPerFile);
