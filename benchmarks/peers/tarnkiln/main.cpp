/// \file
/// Runs workloads on libraries of the given size and prints a line for each figure: whether it is
/// ours or the floor, the name of the workload, and the nanoseconds, or bytes, of one operation.
/// Usage: books_of_tarnkiln BOOKS [NAME...]
#include "benchmarks/peers/tarnkiln/Workloads.h"

#include <climits>
#include <cstdio>
#include <cstdlib>

#include <malloc.h>

namespace {

/// What a round frees is there for the next one, as in the heap of a virtual machine.
void keepFreedMemory()
{
    mallopt(M_TRIM_THRESHOLD, INT_MAX);
    mallopt(M_MMAP_MAX, 0);
}
}  // namespace

int main(int count, char** arguments)
{
    if (count < 2)
    {
        std::fputs("usage: books_of_tarnkiln BOOKS [NAME...]\n", stderr);
        return 2;
    }
    keepFreedMemory();
    peers::Measure const measure(std::strtoul(arguments[1], nullptr, 10),
                                 {arguments + 2, arguments + count});
    {
        peers::FullLibraries libraries(measure.size());
        peers::measureAccess(measure, libraries);
        peers::measureGenerated(measure, libraries);
        peers::measureQueries(measure, libraries);
        peers::measureRecording(measure, libraries);
        peers::measureMoves(measure, libraries);
    }
    peers::measureProxies(measure);
    peers::measureCreation(measure);  // last: what it frees lies scattered
    peers::measureDeletion(measure);
}
