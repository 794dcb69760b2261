// SPDX-License-Identifier: MIT
#include "CheckQueue.h"

#include <algorithm>

CheckQueue::CheckQueue(std::chrono::milliseconds pause) : pause_(pause), worker_([this] { work(); }) {}

CheckQueue::~CheckQueue()
{
    {
        const std::lock_guard lock(mutex_);
        stopping_ = true;
    }
    wake_.notify_all();
    worker_.join();
}

void CheckQueue::schedule(Job job)
{
    {
        const std::lock_guard lock(mutex_);
        auto uri = job.uri;
        waiting_.insert_or_assign(std::move(uri), Waiting{std::move(job), std::chrono::steady_clock::now() + pause_});
    }
    wake_.notify_all();
}

void CheckQueue::forget(const std::string& uri)
{
    const std::lock_guard lock(mutex_);
    waiting_.erase(uri);
}

void CheckQueue::work()
{
    std::unique_lock lock(mutex_);
    while (!stopping_) {
        if (waiting_.empty()) {
            wake_.wait(lock);
            continue;
        }
        const auto next = std::min_element(waiting_.begin(), waiting_.end(),
                                           [](const auto& a, const auto& b) { return a.second.due < b.second.due; });
        if (std::chrono::steady_clock::now() < next->second.due) {
            wake_.wait_until(lock, next->second.due);
            continue;
        }
        auto job = std::move(next->second.job);
        waiting_.erase(next);
        lock.unlock();
        job.run();
        lock.lock();
    }
}
