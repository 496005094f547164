/// \file
/// Loads package indexes that tests hold as texts, in either form.
#pragma once
#include "Forms.h"
#include "Loader.h"
#include "reader/ControlFile.h"
#include "tarnkiln/kernel/ModelImpl.h"

#include <gtest/gtest.h>

#include <sstream>
#include <string>

namespace test {

using debian::ElementForm;

/// What suites that hold for both forms are instantiated with.
using BothForms = testing::Types<debian::Generated, debian::Reflective>;

/// How test reports call the forms.
struct FormName
{
    template <ElementForm Form> static std::string GetName(int /*index*/)
    {
        return std::is_same_v<Form, debian::Generated> ? "Generated" : "Reflective";
    }
};

/// Loads the text, named "index" in errors, into `model`.
template <ElementForm Form>
debian::LoadResult<Form> loadText(tarn::kiln::Model const& model, std::string const& text)
{
    std::istringstream stream(text);
    debian::ControlFile file(stream, "index");
    return debian::Loader<Form>(model).load(file);
}

/// A model that holds an index.
template <ElementForm Form> struct LoadedModel
{
    explicit LoadedModel(std::string const& text)
        : model(tarn::kiln::Model::create(tarn::kiln::ModelConstellation())),
          loaded(loadText<Form>(model, text))
    {}

    debian::Package<Form> package(tarn::kiln::ustring const& name) const
    {
        return loaded.index->getPackages().find(name);
    }
    /// The only release of that package.
    debian::Release<Form> release(tarn::kiln::ustring const& name) const
    {
        for (debian::Release<Form> const& release : debian::members(package(name)->getReleases()))
            return release;
        return {};
    }
    /// An alternative of that release, by the numbers of its group and its place there.
    debian::Alternative<Form> alternative(tarn::kiln::ustring const& name, std::size_t group,
                                          std::size_t place) const
    {
        return release(name)->getGroups().at(group)->getAlternatives().at(place);
    }

    tarn::kiln::Model model;
    debian::LoadResult<Form> loaded;
};

/// A paragraph of a package, version 1 for all architectures; `fields` are lines with newlines.
inline std::string paragraph(std::string const& name, std::string const& fields = "")
{
    return "Package: " + name + "\nVersion: 1\nArchitecture: all\n" + fields + "\n";
}

}  // namespace test
