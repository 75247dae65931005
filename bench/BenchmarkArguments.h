#pragma once

#include <benchmark/benchmark.h>

#include <vector>

// The command line of a benchmark program: Google Benchmark takes its own
// flags first, with random interleaving on unless the command line turns it
// off (a later flag wins); what is left goes to the Qt application.
class BenchmarkArguments
{
public:
    BenchmarkArguments(int argc, char** argv)
        : m_values{argv[0], m_interleave}
    {
        m_values.insert(m_values.end(), argv + 1, argv + argc);
        m_values.push_back(nullptr);
        m_count = int(m_values.size()) - 1;
    }

    // False, with a message, for a flag that neither side knows.
    bool initialize()
    {
        benchmark::Initialize(&m_count, m_values.data());
        return !benchmark::ReportUnrecognizedArguments(m_count, m_values.data());
    }

    BenchmarkArguments(const BenchmarkArguments&) = delete;
    BenchmarkArguments& operator=(const BenchmarkArguments&) = delete;

    int& count() { return m_count; }
    char** values() { return m_values.data(); }

private:
    char m_interleave[44] = "--benchmark_enable_random_interleaving=true";
    std::vector<char*> m_values;
    int m_count = 0;
};
