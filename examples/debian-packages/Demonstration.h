/// \file
/// What the program does with an index.
#pragma once
#include "CommandLine.h"
#include "Figures.h"
#include "Forms.h"
#include "Loader.h"
#include "tarnkiln/kernel/Model.h"

#include <iosfwd>
#include <string>

namespace debian {
class ChangeRecorder;
template <ElementForm Form> class EssentialGuard;
class ModelSnapshot;

/// Loads, has a removal refused, removes and takes the removal back, asks questions, and says so.
/// With questions of the user's own, it asks these and changes nothing.
template <ElementForm Form> class Demonstration
{
public:
    /// \param output  for the report.
    /// \param progress  for the progress bar.
    Demonstration(std::ostream& output, std::ostream& progress, bool progressIsTerminal);

    /// \throws ReadError  as `Loader::load`.
    /// \throws std::runtime_error  as `Interview::ask`.
    /// \returns whether each state that had to equal an earlier one did.
    bool run(CommandLine const& commandLine);
    /// What `run` measured.
    Figures const& figures() const { return m_figures; }

private:
    LoadResult<Form> load(tarn::kiln::Model const& model, std::string const& file,
                          std::string const& prefix);
    void resolve(std::string const& file);
    bool changeAndTakeBack();
    bool removeNeeded(EssentialGuard<Form> const& guard);
    bool removeLeaf(ChangeRecorder const& recorder);
    bool checkEqual(ModelSnapshot const& before, std::string const& occasion);

    std::ostream& m_output;
    std::ostream& m_progress;
    bool m_progressIsTerminal;
    tarn::kiln::Model m_model;
    PackageIndex<Form> m_index;
    Figures m_figures;
};

}  // namespace debian
