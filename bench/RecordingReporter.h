#pragma once

#include <benchmark/benchmark.h>

#include <map>
#include <string>
#include <vector>

// Prints as the console reporter does and keeps the mean real and CPU time
// per iteration of each benchmark (averaged over its repetitions), so that
// ratios can be printed afterwards.
class RecordingReporter : public benchmark::ConsoleReporter
{
public:
    void ReportRuns(const std::vector<Run>& runs) override
    {
        ConsoleReporter::ReportRuns(runs);
        for (const Run& run : runs) {
            if (run.run_type != Run::RT_Iteration || run.error_occurred)
                continue;
            Totals& totals = m_totals[run.run_name.function_name];
            totals.sum += run.GetAdjustedRealTime();
            totals.cpuSum += run.GetAdjustedCPUTime();
            ++totals.count;
        }
    }

    // Mean real time in the benchmark's unit; negative when it did not run.
    double meanRealTime(const std::string& name) const
    {
        const auto found = m_totals.find(name);
        return found == m_totals.end() ? -1.0 : found->second.sum / found->second.count;
    }

    // Mean CPU time, as meanRealTime; steadier than real time on a busy machine.
    double meanCpuTime(const std::string& name) const
    {
        const auto found = m_totals.find(name);
        return found == m_totals.end() ? -1.0 : found->second.cpuSum / found->second.count;
    }

private:
    struct Totals
    {
        double sum = 0.0;
        double cpuSum = 0.0;
        int count = 0;
    };
    std::map<std::string, Totals> m_totals;
};
