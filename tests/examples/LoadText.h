/// \file
/// Loads package indexes that tests hold as texts.
#pragma once
#include "Loader.h"
#include "model/PackageImpl.h"
#include "model/PackageIndexImpl.h"
#include "model/ReleaseImpl.h"
#include "reader/ControlFile.h"
#include "tarnkiln/kernel/ModelImpl.h"

#include <sstream>
#include <string>

namespace test {

/// Loads the text, named "index" in errors, into `model`.
inline debian::LoadResult loadText(tarn::kiln::Model const& model, std::string const& text)
{
    std::istringstream stream(text);
    debian::ControlFile file(stream, "index");
    return debian::Loader(model).load(file);
}

/// A model that holds an index.
struct LoadedModel
{
    explicit LoadedModel(std::string const& text)
        : model(tarn::kiln::Model::create(tarn::kiln::ModelConstellation())),
          loaded(loadText(model, text))
    {}

    debian::model::Package package(tarn::kiln::ustring const& name) const
    {
        return loaded.index->getPackages().find(name);
    }
    /// The only release of that package.
    debian::model::Release release(tarn::kiln::ustring const& name) const
    {
        return package(name)->getReleases().begin()->second;
    }

    tarn::kiln::Model model;
    debian::LoadResult loaded;
};

/// A paragraph of a package, version 1 for all architectures; `fields` are lines with newlines.
inline std::string paragraph(std::string const& name, std::string const& fields = "")
{
    return "Package: " + name + "\nVersion: 1\nArchitecture: all\n" + fields + "\n";
}

}  // namespace test
