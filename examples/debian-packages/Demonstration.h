/// \file
/// What the program does with an index.
#pragma once
#include "CommandLine.h"
#include "Figures.h"
#include "Loader.h"
#include "tarnkiln/kernel/Model.h"

#include <iosfwd>
#include <string>

namespace debian {
class ChangeRecorder;
class EssentialGuard;

/// Loads, has a removal refused, removes and takes the removal back, and says so.
class Demonstration
{
public:
    /// \param output  for the report.
    /// \param progress  for the progress bar.
    Demonstration(std::ostream& output, std::ostream& progress, bool progressIsTerminal);

    /// \throws ReadError  as `Loader::load`.
    /// \returns whether each state that had to equal an earlier one did.
    bool run(CommandLine const& commandLine);

private:
    LoadResult load(tarn::kiln::Model const& model, std::string const& file,
                    std::string const& prefix);
    void resolve(std::string const& file);
    bool removeNeeded(EssentialGuard const& guard);
    bool removeLeaf(ChangeRecorder const& recorder);
    bool checkEqual(class ModelSnapshot const& before, std::string const& occasion);

    std::ostream& m_output;
    std::ostream& m_progress;
    bool m_progressIsTerminal;
    tarn::kiln::Model m_model;
    model::PackageIndex m_index;
    Figures m_figures;
};

}  // namespace debian
