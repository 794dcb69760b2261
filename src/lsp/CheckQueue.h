// SPDX-License-Identifier: MIT
#pragma once

#include <chrono>
#include <condition_variable>
#include <functional>
#include <map>
#include <mutex>
#include <string>
#include <thread>

// Runs the checks of the open documents on a thread of its own, so that the message loop never
// waits for one. A check starts once its document has been left alone for the pause (a typist's
// keystrokes make one check); a newer version of a document replaces the older one that waits,
// and the result of one that ran meanwhile is dropped when a newer one waits.
class CheckQueue {
public:
    // A check of one version of a document; done hears its result unless a newer version came.
    struct Job {
        std::string uri;
        long long version = 0;
        std::function<void()> run;
    };

    explicit CheckQueue(std::chrono::milliseconds pause);
    ~CheckQueue();
    CheckQueue(const CheckQueue&) = delete;
    CheckQueue& operator=(const CheckQueue&) = delete;

    void schedule(Job job);
    // The document closed: its waiting check goes.
    void forget(const std::string& uri);

private:
    struct Waiting {
        Job job;
        std::chrono::steady_clock::time_point due;
    };
    void work();

    std::chrono::milliseconds pause_;
    std::mutex mutex_;
    std::condition_variable wake_;
    std::map<std::string, Waiting> waiting_;
    bool stopping_ = false;
    std::thread worker_;
};
