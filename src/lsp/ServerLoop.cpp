// SPDX-License-Identifier: MIT
#include "ServerLoop.h"

#include <condition_variable>
#include <deque>
#include <fcntl.h>
#include <mutex>
#include <poll.h>
#include <thread>
#include <unistd.h>
#include <variant>

#include "CheckQueue.h"
#include "Framing.h"

namespace {

struct EndOfInput {};
struct Broken {
    std::string problem;
};
using Event = std::variant<std::string, Broken, EndOfInput, CheckedVersion>;

// What the reader and the checks hand to the message loop, in their order.
class Events {
public:
    void post(Event event)
    {
        {
            const std::lock_guard lock(mutex_);
            events_.push_back(std::move(event));
        }
        ready_.notify_one();
    }
    Event take()
    {
        std::unique_lock lock(mutex_);
        ready_.wait(lock, [this] { return !events_.empty(); });
        auto event = std::move(events_.front());
        events_.pop_front();
        return event;
    }

private:
    std::mutex mutex_;
    std::condition_variable ready_;
    std::deque<Event> events_;
};

// Reads messages until the input ends or the loop no longer wants them.
void readMessages(int in, int stop, Events& events)
{
    MessageReader reader(in, stop);
    for (;;) {
        auto read = reader.next();
        if (read.status == MessageReader::Status::End) {
            events.post(EndOfInput{});
            return;
        }
        if (read.status == MessageReader::Status::Broken)
            events.post(Broken{std::move(read.problem)});
        else
            events.post(std::move(read.body));
    }
}

CheckedVersion checkOf(const ServerSetup& setup, std::string uri, long long version, const std::string& text,
                       const std::string& path)
{
    CheckedVersion result{std::move(uri), version, {}, {}};
    try {
        result.findings = setup.check(text, path);
    } catch (const std::exception& failure) {
        result.failure = std::string("The text cannot be checked: ") + failure.what();
    }
    return result;
}

} // namespace

int ServeLanguageClient(int in, int out, const ServerSetup& setup)
{
    int stopPipe[2];
    if (::pipe2(stopPipe, O_CLOEXEC) != 0)
        return 1;
    Events events;
    MessageWriter writer(out);
    int status = 1;
    {
        CheckQueue checks(setup.pause);
        LanguageServer server(
            setup,
            [&writer](const nlohmann::json& message) {
                writer.send(message.dump(-1, ' ', false, nlohmann::json::error_handler_t::replace));
            },
            [&](const Document& document) {
                checks.schedule({document.uri, document.version,
                                 [&setup, &events, uri = document.uri, version = document.version, text = document.text,
                                  path = document.path]() mutable {
                                     events.post(checkOf(setup, uri, version, std::move(text), path));
                                 }});
            },
            [&checks](const std::string& uri) { checks.forget(uri); });
        std::thread reader(readMessages, in, stopPipe[0], std::ref(events));
        while (!server.exited()) {
            auto event = events.take();
            if (std::holds_alternative<EndOfInput>(event))
                break;
            if (auto* body = std::get_if<std::string>(&event))
                server.received(*body);
            else if (auto* broken = std::get_if<Broken>(&event))
                server.broken(broken->problem);
            else
                server.checked(std::get<CheckedVersion>(std::move(event)));
        }
        status = server.exitStatus();
        [[maybe_unused]] const auto told = ::write(stopPipe[1], "", 1);
        reader.join();
    }
    ::close(stopPipe[0]);
    ::close(stopPipe[1]);
    return status;
}
