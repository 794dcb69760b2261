// SPDX-License-Identifier: MIT
#include "LspClient.h"

#include <csignal>
#include <gtest/gtest.h>
#include <poll.h>
#include <sys/wait.h>
#include <thread>
#include <unistd.h>

LspClient::LspClient(const std::vector<std::string>& environment)
{
    int in[2], out[2];
    if (::pipe(in) != 0 || ::pipe(out) != 0)
        throw std::runtime_error("no pipe");
    server_ = ::fork();
    if (server_ == 0) {
        ::dup2(in[0], STDIN_FILENO);
        ::dup2(out[1], STDOUT_FILENO);
        for (int fd : {in[0], in[1], out[0], out[1]})
            ::close(fd);
        for (const auto& setting : environment)
            ::putenv(const_cast<char*>(setting.c_str()));
        ::execl(QUILLMARK_CLI, QUILLMARK_CLI, "lsp", static_cast<char*>(nullptr));
        ::_exit(127);
    }
    ::close(in[0]);
    ::close(out[1]);
    toServer_ = in[1];
    fromServer_ = out[0];
    std::signal(SIGPIPE, SIG_IGN);
}

LspClient::~LspClient()
{
    closeInput();
    if (fromServer_ >= 0)
        ::close(fromServer_);
    if (server_ > 0) {
        ::kill(server_, SIGKILL);
        ::waitpid(server_, nullptr, 0);
    }
}

void LspClient::sendBytes(const std::string& bytes)
{
    for (std::size_t done = 0; done < bytes.size();) {
        const auto wrote = ::write(toServer_, bytes.data() + done, bytes.size() - done);
        ASSERT_GT(wrote, 0) << "the server does not read";
        done += static_cast<std::size_t>(wrote);
    }
}

void LspClient::send(const nlohmann::json& message)
{
    const auto body = message.dump();
    sendBytes("Content-Length: " + std::to_string(body.size()) + "\r\n\r\n" + body);
}

void LspClient::notify(const std::string& method, nlohmann::json params)
{
    send({{"jsonrpc", "2.0"}, {"method", method}, {"params", std::move(params)}});
}

int LspClient::request(const std::string& method, nlohmann::json params)
{
    const int id = nextId_++;
    send({{"jsonrpc", "2.0"}, {"id", id}, {"method", method}, {"params", std::move(params)}});
    return id;
}

std::string LspClient::readSome()
{
    pollfd wait{fromServer_, POLLIN, 0};
    const auto ready = ::poll(&wait, 1, static_cast<int>(std::chrono::milliseconds(patience_).count()));
    if (ready <= 0) {
        ADD_FAILURE() << "the server did not answer within " << patience_.count() << " s";
        ::kill(server_, SIGKILL);
        return {};
    }
    char chunk[65536];
    const auto got = ::read(fromServer_, chunk, sizeof chunk);
    return got > 0 ? std::string(chunk, static_cast<std::size_t>(got)) : std::string();
}

nlohmann::json LspClient::next()
{
    std::size_t headerEnd;
    while ((headerEnd = buffer_.find("\r\n\r\n")) == std::string::npos) {
        const auto more = readSome();
        if (more.empty())
            return nullptr;
        buffer_ += more;
    }
    const auto header = buffer_.substr(0, headerEnd);
    EXPECT_TRUE(header.starts_with("Content-Length: ")) << header;
    const auto length = std::stoul(header.substr(16));
    while (buffer_.size() < headerEnd + 4 + length) {
        const auto more = readSome();
        if (more.empty())
            return nullptr;
        buffer_ += more;
    }
    auto message = nlohmann::json::parse(buffer_.substr(headerEnd + 4, length));
    buffer_.erase(0, headerEnd + 4 + length);
    return message;
}

nlohmann::json LspClient::nextWhere(const std::function<bool(const nlohmann::json&)>& wanted)
{
    for (;;) {
        auto message = next();
        if (message.is_null() || wanted(message))
            return message;
    }
}

nlohmann::json LspClient::responseTo(int id)
{
    return nextWhere([id](const nlohmann::json& message) { return message.value("id", nlohmann::json()) == id; });
}

nlohmann::json LspClient::diagnosticsOf(const std::string& uri)
{
    const auto published = nextWhere([&uri](const nlohmann::json& message) {
        return message.value("method", "") == "textDocument/publishDiagnostics" && message["params"]["uri"] == uri;
    });
    return published.is_null() ? published : published["params"]["diagnostics"];
}

nlohmann::json LspClient::initialize(nlohmann::json capabilities)
{
    const auto id =
        request("initialize", {{"processId", nullptr}, {"rootUri", nullptr}, {"capabilities", capabilities}});
    auto answer = responseTo(id);
    notify("initialized", nlohmann::json::object());
    return answer["result"]["capabilities"];
}

void LspClient::open(const std::string& uri, const std::string& text, int version)
{
    notify("textDocument/didOpen",
           {{"textDocument", {{"uri", uri}, {"languageId", "ldraw"}, {"version", version}, {"text", text}}}});
}

void LspClient::closeInput()
{
    if (toServer_ >= 0)
        ::close(toServer_);
    toServer_ = -1;
}

int LspClient::exitStatus()
{
    closeInput();
    int status = 0;
    const auto deadline = std::chrono::steady_clock::now() + patience_;
    while (::waitpid(server_, &status, WNOHANG) == 0) {
        if (std::chrono::steady_clock::now() > deadline) {
            ADD_FAILURE() << "the server did not end within " << patience_.count() << " s";
            ::kill(server_, SIGKILL);
        }
        std::this_thread::sleep_for(std::chrono::milliseconds(10));
    }
    server_ = -1;
    return WIFEXITED(status) ? WEXITSTATUS(status) : -1;
}

std::string UriOf(const std::string& path) { return "file://" + path; }
