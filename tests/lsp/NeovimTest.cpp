// SPDX-License-Identifier: MIT
#include <chrono>
#include <csignal>
#include <gtest/gtest.h>
#include <sstream>
#include <sys/wait.h>
#include <thread>
#include <unistd.h>

#include "CliRun.h"
#include "LspClient.h"
#include "Processes.h"
#include "TempDir.h"

namespace {

// Neovim as the language client: opens the part, starts the server as its documentation says,
// writes what vim.diagnostic.get gives, one "line:column code message" per finding, applies the
// quick fix offered on the fifth line and saves the file.
constexpr const char* ClientScript = R"lua(
local part, out = os.getenv('QM_PART'), os.getenv('QM_OUT')
vim.cmd('edit ' .. vim.fn.fnameescape(part))
local buffer = vim.api.nvim_get_current_buf()
local client = vim.lsp.start_client({ name = 'quillmark', cmd = { os.getenv('QM_CLI'), 'lsp' },
                                      root_dir = vim.fn.fnamemodify(part, ':h') })
vim.lsp.buf_attach_client(buffer, client)
local published = vim.wait(30000, function() return #vim.diagnostic.get(buffer) > 0 end, 20)
local lines = {}
if not published then table.insert(lines, 'no diagnostics') end
for _, d in ipairs(vim.diagnostic.get(buffer)) do
  table.insert(lines, string.format('%d:%d %s %s', d.lnum + 1, d.col + 1, d.code, d.message))
end
vim.fn.writefile(lines, out)
vim.api.nvim_win_set_cursor(0, { 5, 0 })
local params = vim.lsp.util.make_range_params(0, 'utf-16')
params.context = { diagnostics = {}, only = { 'quickfix' } }
local answers = vim.lsp.buf_request_sync(buffer, 'textDocument/codeAction', params, 30000)
for _, answer in pairs(answers or {}) do
  for _, action in ipairs(answer.result or {}) do
    vim.lsp.util.apply_workspace_edit(action.edit, 'utf-16')
  end
end
vim.cmd('silent write')
vim.lsp.stop_client(client)
vim.cmd('qall!')
)lua";

bool haveNeovim() { return std::system("command -v nvim >/dev/null 2>&1") == 0; }

// Runs the script in a headless Neovim under a watchdog; false when it did not end in time.
bool runNeovim(const TempDir& folder, const std::string& part)
{
    const auto script = folder.write("client.lua", ClientScript);
    const pid_t nvim = StartChild(false, [&] {
        ::setenv("QM_PART", part.c_str(), 1);
        ::setenv("QM_OUT", folder.file("out.txt").c_str(), 1);
        ::setenv("QM_CLI", QUILLMARK_CLI, 1);
        ::setenv("XDG_CONFIG_HOME", folder.path().c_str(), 1);
        ::setenv("XDG_DATA_HOME", folder.path().c_str(), 1);
        ::setenv("XDG_STATE_HOME", folder.path().c_str(), 1);
        ::execlp("nvim", "nvim", "--headless", "--clean", "-n", "-c", ("luafile " + script).c_str(),
                 static_cast<char*>(nullptr));
    });
    const auto deadline = std::chrono::steady_clock::now() + std::chrono::seconds(120);
    int status = 0;
    while (::waitpid(nvim, &status, WNOHANG) == 0) {
        if (std::chrono::steady_clock::now() > deadline) {
            ::kill(nvim, SIGKILL);
            ::waitpid(nvim, &status, 0);
            return false;
        }
        std::this_thread::sleep_for(std::chrono::milliseconds(20));
    }
    return true;
}

} // namespace

TEST(Neovim, ShowsTheFindingsOfCheckTracker)
{
    if (!haveNeovim())
        GTEST_SKIP() << "nvim is not installed (scripts/test installs Debian's neovim)";
    const TempDir folder;
    const auto part = folder.write("3004.dat", SmallPart);
    // What check --tracker says of the same bytes, line for line, the column of the value it names.
    const auto original = ReadBytes(part);
    std::vector<std::string> expected;
    const TempDir before;
    const auto copy = before.write("3004.dat", original);
    std::istringstream checked(RunCliWith({"check", "--tracker", "--quiet", copy}).out);
    for (std::string line; std::getline(checked, line);) {
        // "path:line:column: level: message [id]"
        const auto rest = line.substr(copy.size() + 1);
        const auto number = rest.substr(0, rest.find(':'));
        const auto message = rest.substr(rest.find(": ", rest.find(": ") + 2) + 2);
        const auto open = message.rfind(" [");
        const auto id = message.substr(open + 2, message.size() - open - 3);
        expected.push_back(number + ":" + (id.starts_with("license.") ? "12" : "1") + " " + id + " " +
                           message.substr(0, open));
    }
    ASSERT_FALSE(expected.empty());
    ASSERT_TRUE(runNeovim(folder, part)) << "Neovim did not end within two minutes";
    std::vector<std::string> shown;
    std::istringstream out(ReadBytes(folder.file("out.txt")));
    for (std::string line; std::getline(out, line);)
        shown.push_back(line);
    std::sort(shown.begin(), shown.end());
    std::sort(expected.begin(), expected.end());
    EXPECT_EQ(shown, expected);
    // The quick fix applied and saved: the bytes fix --only writes.
    RunCliWith({"fix", "--only", "license.approved", copy});
    EXPECT_EQ(ReadBytes(part), ReadBytes(copy));
    EXPECT_NE(ReadBytes(part), original);
}
