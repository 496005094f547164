/// \file
/// The workloads, in groups. Each runs, and prints, what the measurement wants of it.
#pragma once
#include "benchmarks/peers/tarnkiln/Library.h"
#include "benchmarks/peers/tarnkiln/Measure.h"
#include "benchmarks/peers/tarnkiln/PlainLibrary.h"

#include <optional>

namespace peers {

/// A full library of each kind, made when it is first asked for.
class FullLibraries
{
public:
    explicit FullLibraries(std::size_t size) : m_size(size) {}

    Library& ours();
    PlainLibrary& plain();

private:
    std::size_t const m_size;
    std::optional<Library> m_ours;
    std::optional<PlainLibrary> m_plain;
};

/// Making and destroying a library, and what it weighs.
void measureCreation(Measure const& measure);
/// Reading, setting and finding books, with nothing recorded.
void measureAccess(Measure const& measure, FullLibraries& libraries);
/// Questions to all books.
void measureQueries(Measure const& measure, FullLibraries& libraries);
/// Setting pages with old values kept, and undoing that.
void measureRecording(Measure const& measure, FullLibraries& libraries);
/// Moving books from one library to the other, recorded, and undoing that.
void measureMoves(Measure const& measure, FullLibraries& libraries);
/// Reading and setting books of a generated class.
void measureGenerated(Measure const& measure, FullLibraries& libraries);
/// Cards that refer to books of another model by UUIDs, which the first read resolves.
void measureProxies(Measure const& measure);
/// Destroying every second book of a library.
void measureDeletion(Measure const& measure);
}  // namespace peers
