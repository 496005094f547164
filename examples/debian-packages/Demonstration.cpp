#include "Demonstration.h"

#include "AllocatedBytes.h"
#include "AvailableModel.h"
#include "ChangeReport.h"
#include "ElementText.h"
#include "EssentialGuard.h"
#include "Interview.h"
#include "ModelSnapshot.h"
#include "PackageGraph.h"
#include "ProgressBar.h"
#include "Removal.h"
#include "Resolution.h"
#include "Undo.h"
#include "reader/ControlFile.h"
#include "tarnkiln/kernel/ModelConstellationImpl.h"
#include "tarnkiln/kernel/ModelImpl.h"
#include "tarnkiln/kernel/Transaction.h"

#include <filesystem>
#include <iostream>
#include <memory>
#include <system_error>

namespace debian {

using namespace tarn::kiln;

namespace {

constexpr std::size_t MAX_REPORT_LINES = 16;
constexpr std::size_t MAX_DIFFERENCES = 10;

std::unique_ptr<ControlFile> open(std::string const& file)
{
    if (file == CommandLine::STANDARD_INPUT)
        return std::make_unique<ControlFile>(std::cin, "standard input");
    return std::make_unique<ControlFile>(file);
}

/// 0 for what has no size, such as a pipe.
std::uintmax_t sizeOf(std::string const& file)
{
    std::error_code error;
    std::uintmax_t const size = std::filesystem::file_size(file, error);
    return error ? 0 : size;
}

}  // namespace

template <ElementForm Form>
Demonstration<Form>::Demonstration(std::ostream& output, std::ostream& progress,
                                   bool progressIsTerminal)
    : m_output(output),
      m_progress(progress),
      m_progressIsTerminal(progressIsTerminal)
{}

template <ElementForm Form> bool Demonstration<Form>::run(CommandLine const& commandLine)
{
    PackageIndex<Form>::metaClass();  // the metamodel is no part of what is measured
    m_model = Model::create(ModelConstellation());
    auto const loaded = load(m_model, commandLine.file, "");
    m_index = loaded.index;
    if (commandLine.available)
        resolve(*commandLine.available);

    bool const asksItself = commandLine.questions.empty();
    bool equal = !asksItself || changeAndTakeBack();
    Interview<Form> interview(m_output, m_figures, m_index, MissingNames(loaded.missing),
                              commandLine.maxRows);
    for (Question const& question : asksItself ? interview.usualQuestions() : commandLine.questions)
        equal = interview.ask(question) && equal;
    return equal;
}

template <ElementForm Form> bool Demonstration<Form>::changeAndTakeBack()
{
    EssentialGuard<Form> guard(m_index);
    ChangeRecorder recorder;
    m_model->addListener(&guard);
    m_model->addListener(&recorder);
    bool equal = removeNeeded(guard);
    equal = removeLeaf(recorder) && equal;
    m_model->removeListener(&recorder);
    m_model->removeListener(&guard);
    return equal;
}

template <ElementForm Form>
LoadResult<Form> Demonstration<Form>::load(Model const& model, std::string const& file,
                                           std::string const& prefix)
{
    auto const input = open(file);
    std::size_t const bytesBefore = allocatedBytes();
    Stopwatch const stopwatch;
    LoadResult<Form> const loaded = [&] {
        ProgressBar bar(m_progress, m_progressIsTerminal, "Reading " + file, sizeOf(file));
        return Loader<Form>(model).load(*input, [&](std::size_t bytes) { bar.update(bytes); });
    }();
    auto const time = stopwatch.elapsed();
    std::size_t const bytes = allocatedBytes() - bytesBefore;
    std::size_t const elements = model->getElementCount();

    m_output << input->name() << ": " << loaded.index->getPackages().size() << " packages with "
             << loaded.releases << " releases, " << loaded.groups << " dependencies with "
             << loaded.alternatives << " alternatives\n"
             << "  passed over: " << loaded.notInstalled << " that are not installed, "
             << loaded.repeated << " repeated\n"
             << "  named, but not in the file: " << loaded.missing.size() << '\n';
    m_output << "  fingerprint: " << ModelSnapshot(model).fingerprint() << '\n';
    m_figures.addCount(prefix + "elements", elements);
    m_figures.addCount(prefix + "bytes per element", bytes / elements);
    m_figures.addTime(prefix + "load", time);
    return loaded;
}

template <ElementForm Form> void Demonstration<Form>::resolve(std::string const& file)
{
    Model const available = Model::create(m_model->getModelConstellation());
    available->setModelURI(AVAILABLE_URI);
    load(available, file, "available: ");

    Stopwatch const stopwatch;
    Resolution const resolution = resolveTargets<Form>(m_index);
    m_figures.addTime("resolution", stopwatch.elapsed());
    m_output << "  of the missing packages of the first file " << resolution.found << " are here, "
             << resolution.notFound << " are not\n";
}

template <ElementForm Form>
bool Demonstration<Form>::removeNeeded(EssentialGuard<Form> const& guard)
{
    Package<Form> const needed = neededByEssential<Form>(m_index);
    if (!needed)
    {
        m_output << "\nNo essential package needs another: nothing to refuse\n";
        return true;
    }
    ModelSnapshot const before(m_model);
    m_output << "\nRemoving " << textOf<Form>(needed) << ", which an essential package needs\n";

    Stopwatch const stopwatch;
    Transaction const transaction = m_model->beginTransaction(/*revertible=*/true);
    removePackages<Form>({needed});
    bool const refused = transaction.commit() == TransactionResult::RolledBack;
    m_figures.addTime("refused removal and rollback", stopwatch.elapsed());

    m_output << (refused ? "  refused: " + guard.reason() : std::string("  was not refused"))
             << '\n';
    return checkEqual(before, "rollback") && refused;
}

template <ElementForm Form> bool Demonstration<Form>::removeLeaf(ChangeRecorder const& recorder)
{
    PackageGraph<Form> const graph(m_index);
    Package<Form> const leaf = graph.chooseLeaf();
    if (!leaf)
    {
        m_output << "\nAll packages are used by others: nothing to remove\n";
        return true;
    }
    ModelSnapshot const before(m_model);
    auto const packages = graph.removableWith(leaf);
    m_output << "\nRemoving " << textOf<Form>(leaf)
             << " with what only it needs: " << packages.size() << " packages\n";

    Stopwatch const removal;
    Transaction const transaction = m_model->beginTransaction(/*revertible=*/true);
    removePackages<Form>(packages);
    bool const committed = transaction.commit() == TransactionResult::Committed;
    m_figures.addTime("removal and commit", removal.elapsed());
    if (!committed)
    {
        m_output << "  was refused\n";
        return false;
    }
    ReportData const report = *recorder.last();
    printReport<Form>(m_output, report, MAX_REPORT_LINES);

    Stopwatch const back;
    undo(report);
    m_figures.addTime("undo", back.elapsed());
    return checkEqual(before, "undo");
}

template <ElementForm Form>
bool Demonstration<Form>::checkEqual(ModelSnapshot const& before, std::string const& occasion)
{
    ModelSnapshot const now(m_model);
    if (now == before)
    {
        m_output << "  after the " << occasion << " all " << now.elementCount()
                 << " elements are as they were\n";
        return true;
    }
    m_output << "  after the " << occasion << " the model differs:\n";
    for (std::string const& line : before.differences(now, MAX_DIFFERENCES))
        m_output << "    " << line << '\n';
    return false;
}

#define DEBIAN_INSTANTIATE(Form) template class Demonstration<Form>;
DEBIAN_FOR_EACH_FORM(DEBIAN_INSTANTIATE)

}  // namespace debian
