// SPDX-License-Identifier: MIT
#include <gtest/gtest.h>
#include <set>
#include <tuple>

#include "CliRun.h"
#include "Clock.h"
#include "Corpus.h"
#include "Dates.h"
#include "LspClient.h"
#include "RuleTexts.h"
#include "TempDir.h"
#include "Text.h"

namespace {

using Json = nlohmann::json;

// A finding as the two sides give it: line (from 1), severity number, id, message.
using Finding = std::tuple<std::size_t, int, std::string, std::string>;

int severityNumber(const std::string& level) { return level == "error" ? 1 : level == "warning" ? 2 : 3; }

// The protocol's line (from 1 here), which a lone CR ends too, of the line check names (a line
// ends at LF there).
std::size_t protocolLine(const std::string& bytes, std::size_t checkLine)
{
    std::size_t line = 1;
    for (std::size_t at = 0, lineFeeds = 1; at < bytes.size() && lineFeeds < checkLine; ++at) {
        const bool lineFeed = bytes[at] == '\n';
        const bool loneReturn = bytes[at] == '\r' && (at + 1 == bytes.size() || bytes[at + 1] != '\n');
        lineFeeds += lineFeed ? 1 : 0;
        line += lineFeed || loneReturn ? 1 : 0;
    }
    return line;
}

// What check --tracker prints for the file, one finding per line: "path:line:column: level: message [id]"
// (line 1, column 1 for the file as a whole, which the server shows on the first line too).
std::multiset<Finding> checkFindings(const std::string& path)
{
    const auto bytes = ReadBytes(path);
    const auto run = RunCliWith({"check", "--tracker", "--quiet", path});
    std::multiset<Finding> findings;
    std::istringstream lines(run.out);
    for (std::string line; std::getline(lines, line);) {
        if (line == path + ": ok")
            continue;
        EXPECT_TRUE(line.starts_with(path + ":")) << line;
        auto rest = line.substr(path.size() + 1);
        const auto number = protocolLine(bytes, std::stoul(rest.substr(0, rest.find(':'))));
        rest.erase(0, rest.find(": ") + 2); // line and column
        const auto level = rest.substr(0, rest.find(':'));
        rest.erase(0, level.size() + 2);
        const auto open = rest.rfind(" [");
        findings.insert(
            {number, severityNumber(level), rest.substr(open + 2, rest.size() - open - 3), rest.substr(0, open)});
    }
    return findings;
}

std::multiset<Finding> serverFindings(const Json& diagnostics)
{
    std::multiset<Finding> findings;
    for (const auto& diagnostic : diagnostics) {
        EXPECT_EQ(diagnostic["source"], "quillmark");
        // Every id is explained: the diagnostic links to its rule's section of docs/rules.md.
        const auto code = diagnostic.value("code", "");
        EXPECT_TRUE(
            diagnostic.value("codeDescription", Json::object()).value("href", "").ends_with("/docs/rules.md#" + code))
            << diagnostic.dump();
        findings.insert({diagnostic["range"]["start"]["line"].get<std::size_t>() + 1, diagnostic["severity"].get<int>(),
                         diagnostic.value("code", ""), diagnostic["message"].get<std::string>()});
    }
    return findings;
}

Json textDocument(const std::string& uri) { return {{"uri", uri}}; }

Json at(std::size_t line, std::size_t character) { return {{"line", line}, {"character", character}}; }

Json change(std::size_t fromLine, std::size_t fromCharacter, std::size_t toLine, std::size_t toCharacter,
            const std::string& text)
{
    return {{"range", {{"start", at(fromLine, fromCharacter)}, {"end", at(toLine, toCharacter)}}}, {"text", text}};
}

int errorCode(const Json& response) { return response.contains("error") ? response["error"].value("code", 0) : 0; }

std::string hoverText(LspClient& client, const std::string& uri, std::size_t line)
{
    const auto answer = client.responseTo(
        client.request("textDocument/hover", {{"textDocument", textDocument(uri)}, {"position", at(line, 2)}}));
    return answer["result"].is_null() ? std::string() : answer["result"]["contents"]["value"].get<std::string>();
}

std::vector<std::string> completionLabels(LspClient& client, const std::string& uri, std::size_t line,
                                          std::size_t character)
{
    const auto answer = client.responseTo(client.request(
        "textDocument/completion", {{"textDocument", textDocument(uri)}, {"position", at(line, character)}}));
    std::vector<std::string> labels;
    for (const auto& item : answer["result"])
        labels.push_back(item["label"]);
    return labels;
}

} // namespace

TEST(LspProtocol, LivesFromInitializeToExit)
{
    LspClient client;
    const auto capabilities = client.initialize();
    EXPECT_EQ(capabilities["positionEncoding"], "utf-16"); // the protocol's default
    EXPECT_EQ(capabilities["textDocumentSync"]["change"], 2);
    EXPECT_TRUE(capabilities["hoverProvider"].get<bool>());
    const auto shutdown = client.responseTo(client.request("shutdown", nullptr));
    EXPECT_TRUE(shutdown.contains("result") && shutdown["result"].is_null());
    // Once shut down, requests are refused.
    EXPECT_EQ(errorCode(client.responseTo(client.request("textDocument/hover", Json::object()))), -32600);
    client.notify("exit", nullptr);
    EXPECT_EQ(client.exitStatus(), 0);

    LspClient utf8;
    EXPECT_EQ(utf8.initialize({{"general", {{"positionEncodings", {"utf-8", "utf-16"}}}}})["positionEncoding"],
              "utf-8");
    utf8.notify("exit", nullptr); // without shutdown
    EXPECT_EQ(utf8.exitStatus(), 1);

    LspClient ended;
    ended.initialize();
    EXPECT_EQ(ended.exitStatus(), 1); // the end of the input without shutdown

    LspClient early;
    // Before initialize, requests are refused.
    EXPECT_EQ(errorCode(early.responseTo(early.request("shutdown", nullptr))), -32002);
}

TEST(LspProtocol, PublishesCheckTrackersFindingsOfCorpusParts)
{
    const auto parts = CorpusPartFiles();
    if (parts.empty())
        GTEST_SKIP() << "the shared corpus is absent";
    const TempDir folder;
    LspClient client;
    client.initialize();
    // Every 97th part: LF and CR LF files, parts, subparts and primitives, with and without
    // findings; and the one with a lone CR.
    std::vector<std::filesystem::path> sample;
    for (std::size_t k = 0; k < parts.size(); k += 97)
        sample.push_back(parts[k]);
    for (const auto& part : parts)
        if (part.filename() == "970phba.dat")
            sample.push_back(part);
    std::size_t compared = 0, withFindings = 0;
    std::set<std::string> written;
    for (const auto& part : sample) {
        // An editor reads a file in ISO-8859-1 as such, and hands the server its text in UTF-8.
        auto bytes = ReadBytes(part.string());
        if (!IsValidUtf8(bytes))
            bytes = Latin1ToUtf8(bytes);
        const auto path = folder.write(part.filename().string(), bytes);
        written.insert(part.filename().string());
        const auto expected = checkFindings(path);
        client.open(UriOf(path), ReadBytes(path));
        EXPECT_EQ(serverFindings(client.diagnosticsOf(UriOf(path))), expected) << part;
        ++compared;
        withFindings += expected.empty() ? 0 : 1;
    }
    EXPECT_GT(withFindings, 3u);
    EXPECT_GT(compared, 10u);
    // Nothing is written beside the documents.
    EXPECT_EQ(NamesIn(folder.path()), written);
}

// The document's folder decides the settings, as for check: the nearest quillmark.toml.
TEST(LspProtocol, ChecksWithTheQuillmarkTomlAboveTheDocument)
{
    const TempDir folder;
    folder.write("quillmark.toml", "ignore = [\"license.\"]\n");
    std::filesystem::create_directory(folder.path() / "parts");
    // A needless zero besides the licence: what the config ignores goes, the rest stays.
    auto part = SmallPart;
    part.replace(part.find("0 0 0 1 0 0 0 1 0 0 0 1 stud"), 7, "0 0 0 1.0");
    const auto path = folder.write("parts/3004.dat", part);
    const auto expected = checkFindings(path);
    EXPECT_TRUE(std::none_of(expected.begin(), expected.end(),
                             [](const Finding& finding) { return std::get<2>(finding).starts_with("license."); }));
    EXPECT_FALSE(expected.empty());
    LspClient client;
    client.initialize();
    client.open(UriOf(path), part);
    EXPECT_EQ(serverFindings(client.diagnosticsOf(UriOf(path))), expected);
}

TEST(LspProtocol, FollowsIncrementalAndFullChanges)
{
    const TempDir folder;
    const auto path = folder.file("3004.dat");
    const auto uri = UriOf(path);
    LspClient client;
    client.initialize();
    client.open(uri, SmallPart);
    client.diagnosticsOf(uri);
    const auto changes = Json::array({
        // an insert: the licence the library accepts before the old one's text, which is then deleted
        change(4, 11, 4, 11, "Licensed under CC BY 4.0 : see CAreadme.txt"),
        change(4, 54, 4, 113, ""),
        // a change across lines: the blank line and the BFC line become one line
        change(5, 0, 6, 17, "0 BFC CERTIFY CW"),
        // a CR LF split: the CR stays, what follows it starts a line of its own
        change(6, 0, 7, 0, "\r"),
        change(7, 0, 7, 0, "0 // \xF0\x9F\x98\x80 comment\n"),
        // a UTF-16 column after a character of two code units
        change(7, 7, 7, 7, "ed"),
    });
    client.notify("textDocument/didChange",
                  {{"textDocument", {{"uri", uri}, {"version", 2}}}, {"contentChanges", changes}});
    const std::string expected = "0 Brick  1 x  2\r\n"
                                 "0 Name: 3004.dat\r\n"
                                 "0 Author: Ann Example [ann]\r\n"
                                 "0 !LDRAW_ORG Unofficial_Part\r\n"
                                 "0 !LICENSE Licensed under CC BY 4.0 : see CAreadme.txt\r\n"
                                 "0 BFC CERTIFY CW\r\n"
                                 "\r"
                                 "0 // \xF0\x9F\x98\x80"
                                 "ed comment\n"
                                 "1 16 0 0 0 1 0 0 0 1 0 0 0 1 stud.dat\r\n";
    TempDir::writeTo(path, expected);
    EXPECT_EQ(serverFindings(client.diagnosticsOf(uri)), checkFindings(path));
    EXPECT_EQ(hoverText(client, uri, 5).substr(0, 4), "BFC:");
    EXPECT_EQ(hoverText(client, uri, 6), "");

    // A full change replaces the whole text.
    client.notify("textDocument/didChange",
                  {{"textDocument", {{"uri", uri}, {"version", 3}}}, {"contentChanges", {{{"text", SmallPart}}}}});
    TempDir::writeTo(path, SmallPart);
    EXPECT_EQ(serverFindings(client.diagnosticsOf(uri)), checkFindings(path));
}

TEST(LspProtocol, PublishesOnlyTheNewestVersionOnTheFindingsWord)
{
    const TempDir folder;
    const auto uri = UriOf(folder.file("3004.dat"));
    LspClient client;
    client.initialize();
    client.open(uri, "0 x\r\n");
    // Typed before the pause ends: the first version's check is replaced by the second's.
    client.notify("textDocument/didChange",
                  {{"textDocument", {{"uri", uri}, {"version", 2}}}, {"contentChanges", {{{"text", SmallPart}}}}});
    const auto published = client.nextWhere(
        [](const Json& message) { return message.value("method", "") == "textDocument/publishDiagnostics"; });
    EXPECT_EQ(published["params"]["version"], 2);
    // The licence finding covers the licence's text, not its line.
    const auto& diagnostics = published["params"]["diagnostics"];
    const auto licence = std::find_if(diagnostics.begin(), diagnostics.end(),
                                      [](const Json& diagnostic) { return diagnostic["code"] == "license.approved"; });
    ASSERT_NE(licence, diagnostics.end());
    EXPECT_EQ((*licence)["range"], Json({{"start", at(4, 11)}, {"end", at(4, 68)}}));
}

TEST(LspProtocol, CountsColumnsAsAgreed)
{
    const TempDir folder;
    const auto uri = UriOf(folder.file("3004.dat"));
    // A licence of four characters: eight bytes in UTF-8, five units in UTF-16.
    auto part = SmallPart;
    part.replace(part.find("Redistributable"), 57, "\xC3\xA9t\xF0\x9F\x98\x80s");
    for (const auto& [encoding, end] : {std::pair{"utf-16", 16}, std::pair{"utf-8", 19}}) {
        LspClient client;
        EXPECT_EQ(client.initialize({{"general", {{"positionEncodings", {encoding}}}}})["positionEncoding"], encoding);
        client.open(uri, part);
        const auto diagnostics = client.diagnosticsOf(uri);
        const auto licence = std::find_if(diagnostics.begin(), diagnostics.end(), [](const Json& diagnostic) {
            return diagnostic["code"] == "license.approved";
        });
        ASSERT_NE(licence, diagnostics.end());
        EXPECT_EQ((*licence)["range"], Json({{"start", at(4, 11)}, {"end", at(4, end)}})) << encoding;
    }
}

namespace {

// The text with a workspace edit of it made, for an ASCII text (where UTF-16 columns are bytes).
std::string applied(std::string text, const Json& edit, const std::string& uri)
{
    std::vector<std::size_t> starts{0};
    for (std::size_t at = 0; at < text.size(); ++at)
        if (text[at] == '\n' || (text[at] == '\r' && (at + 1 == text.size() || text[at + 1] != '\n')))
            starts.push_back(at + 1);
    const auto offset = [&starts](const Json& position) {
        return starts.at(position["line"].get<std::size_t>()) + position["character"].get<std::size_t>();
    };
    auto edits = edit["changes"][uri];
    std::sort(edits.begin(), edits.end(),
              [&](const Json& a, const Json& b) { return offset(a["range"]["start"]) > offset(b["range"]["start"]); });
    for (const auto& change : edits) {
        const auto from = offset(change["range"]["start"]);
        text.replace(from, offset(change["range"]["end"]) - from, change["newText"].get<std::string>());
    }
    return text;
}

Json codeActions(LspClient& client, const std::string& uri, std::size_t fromLine, std::size_t toLine, Json only)
{
    Json context = {{"diagnostics", Json::array()}};
    if (!only.is_null())
        context["only"] = only;
    return client.responseTo(
        client.request("textDocument/codeAction", {{"textDocument", textDocument(uri)},
                                                   {"range", {{"start", at(fromLine, 0)}, {"end", at(toLine, 0)}}},
                                                   {"context", context}}))["result"];
}

// What fix writes for a file of these bytes, run with the arguments on a copy named name.
std::string fixedBytes(const std::string& name, const std::string& bytes, std::vector<std::string> arguments)
{
    const TempDir folder;
    const auto path = folder.write(name, bytes);
    arguments.insert(arguments.begin(), "fix");
    arguments.push_back(path);
    RunCliWith(arguments);
    return ReadBytes(path);
}

} // namespace

TEST(LspProtocol, QuickFixesMakeFixsRepairs)
{
    const auto parts = CorpusPartFiles();
    if (parts.empty())
        GTEST_SKIP() << "the shared corpus is absent";
    const TempDir folder;
    const auto uri = UriOf(folder.file("3004.dat"));
    LspClient client;
    EXPECT_EQ(client.initialize()["codeActionProvider"]["codeActionKinds"],
              Json({"quickfix", "source.fixAll.quillmark"}));
    client.open(uri, SmallPart);
    // On the licence line: its repair, and the repair of everything.
    const auto actions = codeActions(client, uri, 4, 4, nullptr);
    ASSERT_EQ(actions.size(), 2u) << actions.dump();
    EXPECT_EQ(actions[0]["kind"], "quickfix");
    EXPECT_EQ(actions[0]["diagnostics"][0]["code"], "license.approved");
    EXPECT_EQ(applied(SmallPart, actions[0]["edit"], uri),
              fixedBytes("3004.dat", SmallPart, {"--only", "license.approved"}));
    EXPECT_NE(applied(SmallPart, actions[0]["edit"], uri), SmallPart);
    EXPECT_EQ(actions[1]["kind"], "source.fixAll.quillmark");
    // None on a line without a finding fix repairs; only what the client asks for.
    EXPECT_EQ(codeActions(client, uri, 8, 8, {"quickfix"}), Json::array());
    EXPECT_EQ(codeActions(client, uri, 4, 4, {"source"}).size(), 1u);

    // source.fixAll on corpus parts: the bytes fix writes.
    std::size_t repaired = 0;
    for (std::size_t k = 0; k < parts.size() && repaired < 5; k += 37) {
        const auto bytes = ReadBytes(parts[k].string());
        if (!IsValidUtf8(bytes))
            continue;
        const auto name = parts[k].filename().string();
        const auto partUri = UriOf(folder.file(name));
        client.open(partUri, bytes);
        const auto fixAll = codeActions(client, partUri, 0, 0, {"source.fixAll"});
        const auto expected = fixedBytes(name, bytes, {});
        if (expected == bytes) {
            EXPECT_EQ(fixAll, Json::array()) << name;
            continue;
        }
        ASSERT_EQ(fixAll.size(), 1u) << name;
        EXPECT_EQ(applied(bytes, fixAll[0]["edit"], partUri), expected) << name;
        ++repaired;
    }
    EXPECT_EQ(repaired, 5u);
}

TEST(LspProtocol, AnswersBrokenMessagesAndGoesOn)
{
    LspClient client;
    client.initialize();
    client.sendBytes("Content-Length: 8\r\n\r\n{\"jsonrp");
    EXPECT_EQ(errorCode(client.next()), -32700);
    client.sendBytes("Content-Type: x\r\n\r\n");
    const auto noLength = client.next();
    EXPECT_EQ(errorCode(noLength), -32700);
    EXPECT_TRUE(noLength["id"].is_null());
    client.send(Json::array({1, 2}));
    EXPECT_EQ(errorCode(client.next()), -32600);
    client.send({{"jsonrpc", "2.0"}, {"id", 77}, {"method", 3}});
    const auto notAMethod = client.next();
    EXPECT_EQ(errorCode(notAMethod), -32600);
    EXPECT_EQ(notAMethod["id"], 77);
    // An unknown notification is ignored: the next message answers the next request.
    client.notify("workspace/didChangeConfiguration", {{"settings", Json::object()}});
    const auto unknown = client.request("textDocument/formatting", Json::object());
    const auto answer = client.next();
    EXPECT_EQ(answer["id"], unknown);
    EXPECT_EQ(errorCode(answer), -32601);
    EXPECT_TRUE(client.responseTo(client.request("shutdown", nullptr))["result"].is_null());
}

TEST(LspProtocol, CancelAnswersAWaitingRequest)
{
    const TempDir folder;
    const auto uri = UriOf(folder.file("3004.dat"));
    LspClient client;
    client.initialize();
    client.open(uri, SmallPart);
    // A hover waits for the findings of the text as it stands, whose check waits for the typing to pause.
    const auto hover =
        client.request("textDocument/hover", {{"textDocument", textDocument(uri)}, {"position", at(4, 3)}});
    client.notify("$/cancelRequest", {{"id", hover}});
    EXPECT_EQ(errorCode(client.responseTo(hover)), -32800);
    EXPECT_TRUE(client.responseTo(client.request("shutdown", nullptr))["result"].is_null());
}

TEST(LspProtocol, HoverTellsTheLinesMeaningAndItsFindings)
{
    const TempDir folder;
    const auto uri = UriOf(folder.file("3004.dat"));
    LspClient client;
    client.initialize();
    client.open(uri, SmallPart);
    const auto licence = hoverText(client, uri, 4);
    EXPECT_TRUE(licence.starts_with("!LICENSE: ")) << licence;
    EXPECT_NE(licence.find("license.approved"), std::string::npos) << licence;
    // The finding's explanation, as explain gives it.
    EXPECT_NE(licence.find(RuleDescription(*FindRuleText("license.approved"))), std::string::npos) << licence;
    EXPECT_TRUE(hoverText(client, uri, 1).starts_with("Name: "));
    EXPECT_EQ(hoverText(client, uri, 8), ""); // a type 1 line without a finding
}

TEST(LspProtocol, CompletesHeaderValues)
{
    const TempDir config;
    std::filesystem::create_directory(config.path() / "Quillmark");
    TempDir::writeTo(config.file("Quillmark/Quillmark.ini"), "[DEFAULT]\nUserName=ann\n");
    const TempDir folder;
    const auto uri = UriOf(folder.file("3004.dat"));
    LspClient client({"XDG_CONFIG_HOME=" + config.path().string()});
    client.initialize();
    client.open(uri,
                "0 \r\n0 !CATEGORY Mini\r\n0 !HISTORY \r\n0 !LICENSE \r\n0 BFC NO\r\n0 !LDRAW_ORG Unofficial_P\r\n");
    const auto keywords = completionLabels(client, uri, 0, 2);
    EXPECT_EQ(keywords.size(), 10u);
    EXPECT_NE(std::find(keywords.begin(), keywords.end(), "!LDRAW_ORG "), keywords.end());
    const auto categories = completionLabels(client, uri, 1, 16);
    EXPECT_FALSE(categories.empty());
    for (const auto& category : categories)
        EXPECT_TRUE(category.starts_with("Minifig ")) << category;
    const auto today = SystemClock().now();
    EXPECT_EQ(completionLabels(client, uri, 2, 11),
              std::vector<std::string>{FormatDate(today.year, today.month, today.day) + " [ann] "});
    EXPECT_EQ(completionLabels(client, uri, 3, 11).front(), "Licensed under CC BY 4.0 : see CAreadme.txt");
    EXPECT_EQ(completionLabels(client, uri, 4, 8), std::vector<std::string>{"NOCERTIFY"});
    EXPECT_EQ(completionLabels(client, uri, 5, 25),
              (std::vector<std::string>{"Unofficial_Part", "Unofficial_Primitive", "Unofficial_Part Alias",
                                        "Unofficial_Part Flexible_Section"}));
}
