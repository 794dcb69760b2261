// SPDX-License-Identifier: MIT
#include "LanguageServer.h"

#include <algorithm>

#include "HeaderHelp.h"
#include "LspRanges.h"
#include "RuleTexts.h"

namespace {

namespace ErrorCode {
constexpr int ParseError = -32700;
constexpr int InvalidRequest = -32600;
constexpr int MethodNotFound = -32601;
constexpr int InvalidParams = -32602;
constexpr int ServerNotInitialized = -32002;
constexpr int RequestCancelled = -32800;
} // namespace ErrorCode

constexpr const char* FixAllKind = "source.fixAll.quillmark";

// Whether the client asks for actions of that kind: all when it names none, else those of a kind
// it names or below one ("source" holds "source.fixAll.quillmark").
bool kindWanted(const nlohmann::json& context, std::string_view kind)
{
    if (!context.contains("only"))
        return true;
    for (const auto& wanted : context["only"]) {
        const auto& name = wanted.get_ref<const std::string&>();
        if (kind == name || (kind.starts_with(name) && kind[name.size()] == '.'))
            return true;
    }
    return false;
}

bool isRepaired(const std::string& id)
{
    const auto& fixes = TrackerFixes();
    return std::any_of(fixes.begin(), fixes.end(), [&id](const TrackerFix& fix) { return id == fix.id; });
}

// A request's id is a number or a string.
bool isId(const nlohmann::json& id) { return id.is_number_integer() || id.is_string(); }

const std::string& uriOf(const nlohmann::json& params)
{
    return params.at("textDocument").at("uri").get_ref<const std::string&>();
}

TextChange changeFromJson(const nlohmann::json& json)
{
    TextChange change{std::nullopt, json.at("text").get<std::string>()};
    if (json.contains("range")) {
        const auto start = PositionFromJson(json["range"].at("start"));
        const auto end = PositionFromJson(json["range"].at("end"));
        if (!start || !end)
            throw std::invalid_argument("a change's range is not a range");
        change.range = {*start, *end};
    }
    return change;
}

} // namespace

LanguageServer::LanguageServer(const ServerSetup& setup, Send send, StartCheck startCheck, ForgetCheck forgetCheck)
    : setup_(setup), send_(std::move(send)), startCheck_(std::move(startCheck)), forgetCheck_(std::move(forgetCheck))
{
}

void LanguageServer::respond(const nlohmann::json& id, nlohmann::json result)
{
    send_({{"jsonrpc", "2.0"}, {"id", id}, {"result", std::move(result)}});
}

void LanguageServer::fail(const nlohmann::json& id, int code, const std::string& message)
{
    send_({{"jsonrpc", "2.0"}, {"id", id}, {"error", {{"code", code}, {"message", message}}}});
}

void LanguageServer::broken(const std::string& problem)
{
    fail(nullptr, ErrorCode::ParseError, "Not a message of the base protocol: " + problem + ".");
}

void LanguageServer::received(const std::string& body)
{
    auto message = nlohmann::json::parse(body, nullptr, false);
    if (message.is_discarded()) {
        fail(nullptr, ErrorCode::ParseError, "The message is not JSON.");
        return;
    }
    const bool hasId = message.is_object() && message.contains("id");
    const auto id = hasId && isId(message["id"]) ? message["id"] : nlohmann::json(nullptr);
    if (!message.is_object() || message.value("jsonrpc", "") != "2.0" || (hasId && !isId(message["id"]))) {
        fail(id, ErrorCode::InvalidRequest, "The message is not a JSON-RPC 2.0 request or notification.");
        return;
    }
    if (!message.contains("method")) {
        if (!hasId || !(message.contains("result") || message.contains("error")))
            fail(id, ErrorCode::InvalidRequest, "The message has no method.");
        return; // a response: this server asks the client nothing
    }
    if (!message["method"].is_string()) {
        fail(id, ErrorCode::InvalidRequest, "The method is not a text.");
        return;
    }
    const auto& method = message["method"].get_ref<const std::string&>();
    const auto params = message.value("params", nlohmann::json::object());
    try {
        if (hasId)
            request({id, method, params});
        else
            notification(method, params);
    } catch (const std::exception& problem) {
        if (hasId)
            fail(id, ErrorCode::InvalidParams, std::string("The parameters do not fit the method: ") + problem.what());
    }
}

void LanguageServer::notification(const std::string& method, const nlohmann::json& params)
{
    if (method == "exit") {
        exited_ = true;
        return;
    }
    if (!initialized_ || shutDown_)
        return; // dropped, as the protocol asks
    if (method == "textDocument/didOpen")
        opened(params);
    else if (method == "textDocument/didChange")
        changed(params);
    else if (method == "textDocument/didClose")
        closed(params);
    else if (method == "textDocument/didSave") {
        // The text is the same; the files beside it (the colour list) may not be.
        if (const auto* document = documents_.find(uriOf(params)))
            startCheck_(*document);
    } else if (method == "$/cancelRequest")
        cancel(params.at("id"));
    // initialized, $/setTrace and every other notification: nothing to do
}

void LanguageServer::request(const Request& request)
{
    if (request.method == "initialize") {
        if (initialized_)
            fail(request.id, ErrorCode::InvalidRequest, "The server is initialized already.");
        else
            respond(request.id, initialize(request.params));
        return;
    }
    if (!initialized_) {
        fail(request.id, ErrorCode::ServerNotInitialized, "The server is not initialized yet.");
        return;
    }
    if (shutDown_) {
        fail(request.id, ErrorCode::InvalidRequest, "The server is shut down.");
        return;
    }
    if (request.method == "shutdown") {
        shutDown_ = true;
        respond(request.id, nullptr);
        return;
    }
    if (auto result = answer(request))
        respond(request.id, std::move(*result));
}

std::optional<nlohmann::json> LanguageServer::answer(const Request& request)
{
    const bool hover = request.method == "textDocument/hover";
    const bool actions = request.method == "textDocument/codeAction";
    if (!hover && !actions && request.method != "textDocument/completion") {
        fail(request.id, ErrorCode::MethodNotFound, "The server has no method " + request.method + ".");
        return std::nullopt;
    }
    const auto& uri = uriOf(request.params);
    const auto* document = documents_.find(uri);
    const auto position = actions ? std::optional<TextPosition>() : PositionFromJson(request.params.at("position"));
    if (document == nullptr || (!actions && !position)) {
        fail(request.id, ErrorCode::InvalidParams, "No open document at that position.");
        return std::nullopt;
    }
    if (!hover && !actions)
        return completion(*document, *position);
    if (currentFindings(*document) == nullptr) {
        waiting_[uri].push_back(request); // answered when the check of this version is done
        return std::nullopt;
    }
    return hover ? this->hover(*document, *position) : codeActions(*document, request.params);
}

nlohmann::json LanguageServer::initialize(const nlohmann::json& params)
{
    const auto encodings =
        params.value("/capabilities/general/positionEncodings"_json_pointer, nlohmann::json::array());
    const bool utf8 = encodings.is_array() && std::find(encodings.begin(), encodings.end(), "utf-8") != encodings.end();
    encoding_ = utf8 ? PositionEncoding::Utf8 : PositionEncoding::Utf16;
    initialized_ = true;
    return {{"capabilities",
             {{"positionEncoding", utf8 ? "utf-8" : "utf-16"},
              {"textDocumentSync", {{"openClose", true}, {"change", 2}, {"save", {{"includeText", false}}}}},
              {"hoverProvider", true},
              {"codeActionProvider", {{"codeActionKinds", {"quickfix", FixAllKind}}}},
              {"completionProvider", {{"triggerCharacters", {" "}}}}}},
            {"serverInfo", {{"name", "quillmark"}, {"version", setup_.version}}}};
}

void LanguageServer::opened(const nlohmann::json& params)
{
    const auto& item = params.at("textDocument");
    const auto& document = documents_.open(item.at("uri").get<std::string>(), item.at("text").get<std::string>(),
                                           item.at("version").get<long long>());
    startCheck_(document);
}

void LanguageServer::changed(const nlohmann::json& params)
{
    const auto& uri = uriOf(params);
    std::vector<TextChange> changes;
    for (const auto& change : params.at("contentChanges"))
        changes.push_back(changeFromJson(change));
    const auto version = params.at("textDocument").at("version").get<long long>();
    if (documents_.change(uri, version, changes, encoding_))
        startCheck_(*documents_.find(uri));
}

void LanguageServer::closed(const nlohmann::json& params)
{
    const auto uri = uriOf(params);
    documents_.close(uri);
    forgetCheck_(uri);
    checked_.erase(uri);
    for (const auto& request : std::exchange(waiting_[uri], {}))
        fail(request.id, ErrorCode::RequestCancelled, "The document was closed.");
    waiting_.erase(uri);
    send_({{"jsonrpc", "2.0"},
           {"method", "textDocument/publishDiagnostics"},
           {"params", {{"uri", uri}, {"diagnostics", nlohmann::json::array()}}}});
}

void LanguageServer::cancel(const nlohmann::json& id)
{
    for (auto& [uri, requests] : waiting_)
        for (auto request = requests.begin(); request != requests.end(); ++request)
            if (request->id == id) {
                fail(id, ErrorCode::RequestCancelled, "The request was cancelled.");
                requests.erase(request);
                return;
            }
}

void LanguageServer::checked(CheckedVersion result)
{
    const auto* document = documents_.find(result.uri);
    if (document == nullptr || document->version != result.version)
        return; // a newer version's check is on its way
    const auto uri = result.uri;
    checked_[uri] = std::move(result);
    publish(*document);
    for (const auto& request : std::exchange(waiting_[uri], {}))
        if (auto answered = answer(request))
            respond(request.id, std::move(*answered));
}

const std::vector<FileFinding>* LanguageServer::currentFindings(const Document& document) const
{
    const auto found = checked_.find(document.uri);
    return found != checked_.end() && found->second.version == document.version ? &found->second.findings : nullptr;
}

void LanguageServer::publish(const Document& document)
{
    const auto& result = checked_.at(document.uri);
    auto diagnostics = nlohmann::json::array();
    for (const auto& finding : result.findings)
        diagnostics.push_back(DiagnosticJson(document, finding, encoding_));
    if (!result.failure.empty())
        diagnostics.push_back({{"range", LineRangeJson(document, 0, encoding_)},
                               {"severity", 1},
                               {"source", "quillmark"},
                               {"message", result.failure}});
    send_({{"jsonrpc", "2.0"},
           {"method", "textDocument/publishDiagnostics"},
           {"params", {{"uri", document.uri}, {"version", document.version}, {"diagnostics", diagnostics}}}});
}

std::string LanguageServer::lineText(const Document& document, std::size_t line) const
{
    const auto& lines = document.lines();
    if (line >= lines.lineCount())
        return {};
    const auto start = lines.lineStart(line);
    return document.text.substr(start, lines.contentEnd(document.text, line) - start);
}

nlohmann::json LanguageServer::hover(const Document& document, TextPosition position) const
{
    std::string text = MetaLineHelp(lineText(document, position.line));
    for (const auto& finding : *currentFindings(document))
        if (LineOfFinding(document, finding) == position.line) {
            if (!text.empty())
                text += "\n\n";
            text += std::string(SeverityText(finding.severity)) + " " + finding.id + ": " + finding.message;
            if (const auto* rule = FindRuleText(finding.id))
                text += "\n" + RuleDescription(*rule);
        }
    if (text.empty())
        return nullptr;
    return {{"contents", {{"kind", "plaintext"}, {"value", text}}},
            {"range", LineRangeJson(document, position.line, encoding_)}};
}

nlohmann::json LanguageServer::completion(const Document& document, TextPosition position) const
{
    const auto& lines = document.lines();
    if (position.line >= lines.lineCount())
        return nlohmann::json::array();
    const auto start = lines.lineStart(position.line);
    const auto cursor = lines.offsetOf(document.text, position, encoding_);
    auto lists = setup_.lists;
    lists.historyStart = setup_.historyStart();
    const auto found = CompleteHeaderLine(std::string_view(document.text).substr(start, cursor - start), lists);
    const auto from = lines.positionOf(document.text, cursor - found.typed, encoding_);
    const auto to = lines.positionOf(document.text, cursor, encoding_);
    auto items = nlohmann::json::array();
    for (const auto& text : found.texts)
        items.push_back(
            {{"label", text},
             {"kind", 12}, // Value
             {"textEdit", {{"range", {{"start", PositionJson(from)}, {"end", PositionJson(to)}}}, {"newText", text}}}});
    return items;
}

nlohmann::json LanguageServer::repairAction(const Document& document, const std::set<std::string>& chosen,
                                            const char* kind, const std::string& title) const
{
    FileRepairs repairs;
    try {
        repairs = setup_.repair(document.text, document.path, chosen);
    } catch (const std::exception&) {
        return nullptr; // a text that cannot be read has no repairs
    }
    if (!repairs.left.empty() || repairs.edits.empty())
        return nullptr;
    const auto& lines = document.lines();
    auto edits = nlohmann::json::array();
    for (const auto& edit : repairs.edits)
        edits.push_back({{"range",
                          {{"start", PositionJson(lines.positionOf(document.text, edit.begin, encoding_))},
                           {"end", PositionJson(lines.positionOf(document.text, edit.end, encoding_))}}},
                         {"newText", edit.replacement}});
    return {{"title", title}, {"kind", kind}, {"edit", {{"changes", {{document.uri, edits}}}}}};
}

nlohmann::json LanguageServer::codeActions(const Document& document, const nlohmann::json& params) const
{
    const auto& range = params.at("range");
    const auto from = PositionFromJson(range.at("start")), to = PositionFromJson(range.at("end"));
    if (!from || !to)
        throw std::invalid_argument("the range is not a range");
    const auto context = params.value("context", nlohmann::json::object());
    auto actions = nlohmann::json::array();
    if (kindWanted(context, "quickfix")) {
        std::set<std::string> offered;
        for (const auto& finding : *currentFindings(document)) {
            auto diagnostic = DiagnosticJson(document, finding, encoding_);
            const auto start = *PositionFromJson(diagnostic["range"]["start"]);
            const auto end = *PositionFromJson(diagnostic["range"]["end"]);
            // The findings on the range's lines (a cursor asks for its line), each id's repair once.
            if (to->line < start.line || end.line < from->line || !isRepaired(finding.id) ||
                !offered.insert(finding.id).second)
                continue;
            auto action = repairAction(document, {finding.id}, "quickfix", "Repair " + finding.id + " as fix does");
            if (action.is_null())
                continue;
            action["diagnostics"] = {std::move(diagnostic)};
            action["isPreferred"] = true;
            actions.push_back(std::move(action));
        }
    }
    if (kindWanted(context, FixAllKind)) {
        auto all = repairAction(document, DefaultFixIds(), FixAllKind, "Repair every finding fix repairs");
        if (!all.is_null())
            actions.push_back(std::move(all));
    }
    return actions;
}
