// SPDX-License-Identifier: MIT
#include "Batch.h"

#include <algorithm>
#include <atomic>
#include <chrono>
#include <condition_variable>
#include <csignal>
#include <cstdio>
#include <mutex>
#include <optional>
#include <system_error>
#include <thread>
#include <vector>

namespace {

class ProgressLine {
public:
    ProgressLine(std::ostream* out, std::size_t total) : out_(out), total_(total) {}
    ~ProgressLine()
    {
        if (out_ != nullptr)
            *out_ << "\r\033[K" << std::flush; // the line goes; the summary takes its place
    }
    ProgressLine(const ProgressLine&) = delete;
    ProgressLine& operator=(const ProgressLine&) = delete;

    void show(std::size_t done)
    {
        using namespace std::chrono;
        const auto now = steady_clock::now();
        if (out_ == nullptr || (now - lastDrawn_ < milliseconds(100) && done < total_))
            return;
        lastDrawn_ = now;
        const double seconds = std::max(duration<double>(now - start_).count(), 1e-6);
        char text[96];
        std::snprintf(text, sizeof text, "%zu of %zu files, %.0f files/s", done, total_,
                      static_cast<double>(done) / seconds);
        *out_ << "\r\033[K" << text << std::flush;
    }

private:
    std::ostream* out_;
    std::size_t total_;
    std::chrono::steady_clock::time_point start_ = std::chrono::steady_clock::now();
    std::chrono::steady_clock::time_point lastDrawn_{};
};

// The next report in order once a worker has it; none when the workers stopped before it.
std::optional<FileReport> takeWhenDone(std::optional<FileReport>& slot, std::mutex& mutex,
                                       std::condition_variable& finished, const std::size_t& working)
{
    std::unique_lock lock(mutex);
    finished.wait(lock, [&] { return slot.has_value() || working == 0; });
    auto report = std::move(slot);
    slot.reset();
    return report;
}

} // namespace

bool RunInOrder(std::size_t count, unsigned threads, const std::function<FileReport(std::size_t)>& work,
                const std::function<bool(FileReport&)>& emit, std::ostream* progress)
{
    std::vector<std::optional<FileReport>> reports(count);
    std::mutex mutex;
    std::condition_variable finished;
    std::atomic<std::size_t> next{0};
    std::atomic<bool> stopped{false};
    const auto planned = std::min<std::size_t>(threads, count);
    std::size_t working = planned;
    const auto mayBegin = [&] { return !stopped && !InterruptPending(); };
    const auto worker = [&] {
        for (auto index = next++; index < count && mayBegin(); index = next++) {
            auto report = work(index);
            const std::lock_guard lock(mutex);
            reports[index] = std::move(report);
            finished.notify_one();
        }
        const std::lock_guard lock(mutex);
        --working;
        finished.notify_one();
    };
    std::vector<std::jthread> pool;
    try {
        for (std::size_t i = 0; i < planned; ++i)
            pool.emplace_back(worker);
    } catch (const std::system_error&) {
        // A process or thread limit: the run goes on with the threads it has.
        const std::lock_guard lock(mutex);
        working -= planned - pool.size();
    }
    ProgressLine line(progress, count);
    for (std::size_t index = 0; index < count; ++index) {
        // Without a single thread of its own, the calling thread does the work, one file at a time.
        auto report = !pool.empty() ? takeWhenDone(reports[index], mutex, finished, working)
                      : mayBegin()  ? std::optional(work(next++))
                                    : std::nullopt;
        if (!report)
            return false; // the run stopped before this file
        if (!emit(*report))
            stopped = true;
        line.show(index + 1);
    }
    return !stopped;
}

void HoldInterrupts()
{
    sigset_t interrupts;
    ::sigemptyset(&interrupts);
    ::sigaddset(&interrupts, SIGINT);
    ::sigaddset(&interrupts, SIGTERM);
    ::pthread_sigmask(SIG_BLOCK, &interrupts, nullptr);
}

bool InterruptPending()
{
    sigset_t pending;
    return ::sigpending(&pending) == 0 &&
           (::sigismember(&pending, SIGINT) == 1 || ::sigismember(&pending, SIGTERM) == 1);
}

unsigned ThreadsFor(unsigned asked) { return asked > 0 ? asked : std::max(1u, std::thread::hardware_concurrency()); }
