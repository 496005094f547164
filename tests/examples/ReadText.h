/// \file
/// Reads package indexes that tests hold as texts.
#pragma once
#include "reader/ControlFile.h"
#include "reader/PackageReader.h"
#include "reader/ReadError.h"

#include <gtest/gtest.h>

#include <sstream>
#include <string>
#include <vector>

namespace test {

/// All packages of an index, named "index" in errors.
inline std::vector<debian::PackageParagraph> readPackages(std::string const& text)
{
    std::istringstream stream(text);
    debian::ControlFile file(stream, "index");
    debian::PackageReader reader(file);
    std::vector<debian::PackageParagraph> packages;
    while (auto package = reader.next())
        packages.push_back(std::move(*package));
    return packages;
}

/// All paragraphs of a control file named "index".
inline std::vector<debian::Paragraph> readParagraphs(std::string const& text)
{
    std::istringstream stream(text);
    debian::ControlFile file(stream, "index");
    std::vector<debian::Paragraph> paragraphs;
    for (debian::Paragraph paragraph; file.next(paragraph);)
        paragraphs.push_back(paragraph);
    return paragraphs;
}

/// The text of the error that `read(text)` raises; a test failure and an empty text without one.
template <class Read> std::string errorOf(Read const& read, std::string const& text)
{
    try
    {
        read(text);
    }
    catch (debian::ReadError const& error)
    {
        return error.what();
    }
    ADD_FAILURE() << "no ReadError";
    return {};
}

}  // namespace test
