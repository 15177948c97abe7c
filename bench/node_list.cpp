// How fast the runtime's node list is with many nodes.
//
//   Alternate/N  one node deleted and a new one added, in a list of N nodes; must not grow with N
//   Rebuild/N    N nodes deleted and N added, as a refresh does it; may grow linearly with N

#include "host/ManagementInterface.h"
#include "host/MutableNode.h"

#include <benchmark/benchmark.h>

#include <cstdint>
#include <deque>

namespace
{

/** A list of nodes that are added and deleted as a plug-in does. */
class Nodes
{
public:
    explicit Nodes(std::size_t count)
    {
        for (std::size_t added = 0; added < count; ++added)
            add();
    }

    ~Nodes()
    {
        interface_.unload();
    }

    Nodes(Nodes const&) = delete;
    Nodes& operator=(Nodes const&) = delete;

    void add()
    {
        IC::Node* node = new IC::MutableNode(++lastId_, 0, {1}, 46, 0);
        interface_.addNewNode(node);
        nodes_.push_back(node);
    }

    void deleteOldest()
    {
        interface_.deleteNode(nodes_.front());
        nodes_.pop_front();
    }

private:
    IC::ManagementInterface interface_;
    std::deque<IC::Node*> nodes_;
    unsigned int lastId_ = 0;
};

void alternate(benchmark::State& state)
{
    Nodes nodes(static_cast<std::size_t>(state.range(0)));
    for (auto _ : state) {
        nodes.deleteOldest();
        nodes.add();
    }
    state.SetComplexityN(state.range(0));
}

void rebuild(benchmark::State& state)
{
    Nodes nodes(static_cast<std::size_t>(state.range(0)));
    for (auto _ : state) {
        for (std::int64_t count = 0; count < state.range(0); ++count)
            nodes.deleteOldest();
        for (std::int64_t count = 0; count < state.range(0); ++count)
            nodes.add();
    }
    state.SetComplexityN(state.range(0));
}

BENCHMARK(alternate)->Name("Alternate")->RangeMultiplier(4)->Range(1000, 64000)->Complexity();
BENCHMARK(rebuild)->Name("Rebuild")->RangeMultiplier(4)->Range(1000, 64000)->Complexity();

} // namespace

BENCHMARK_MAIN();
