// SPDX-License-Identifier: MIT
#include "FieldsJson.h"

#include <nlohmann/json.hpp>

#include "Text.h"

namespace {

nlohmann::json textList(const EntryList& list, TextEncoding encoding)
{
    auto array = nlohmann::json::array();
    for (const auto entry : list)
        array.push_back(HeaderTextForJson(entry, encoding));
    return array;
}

} // namespace

std::string TextForJson(const std::string& path) { return IsValidUtf8(path) ? path : Latin1ToUtf8(path); }

std::string HeaderTextForJson(std::string_view text, TextEncoding encoding)
{
    // A text a command composed into a UTF-8 file from other bytes is still shown, byte by byte.
    return encoding == TextEncoding::Utf8 && IsValidUtf8(text) ? std::string(text) : Latin1ToUtf8(text);
}

std::string FieldsJson(const HeaderData& h)
{
    const auto text = [&h](std::string_view field) { return HeaderTextForJson(field, h.Encoding); };
    nlohmann::ordered_json json;
    json["FilePath"] = TextForJson(h.FilePath);
    json["FileFolder"] = TextForJson(h.FileFolder);
    json["PartName"] = text(h.PartName);
    json["PartDescription"] = text(h.PartDescription);
    json["NeedsWork"] = h.NeedsWork;
    json["ParsedRealName"] = text(h.ParsedRealName);
    json["AuthorRealName"] = text(h.AuthorRealName);
    json["AuthorUserName"] = text(h.AuthorUserName);
    json["PartType"] = text(h.PartType);
    json["UpdateTag"] = text(h.UpdateTag);
    json["License"] = text(h.License);
    json["Bfc"] = text(h.Bfc);
    json["Category"] = text(h.Category);
    json["Keywords"] = textList(h.Keywords, h.Encoding);
    json["History"] = textList(h.History, h.Encoding);
    json["Comments"] = textList(h.Comments, h.Encoding);
    json["HelpLines"] = textList(h.HelpLines, h.Encoding);
    json["CmdLines"] = textList(h.CmdLines, h.Encoding);
    json["ColorLines"] = textList(h.ColorLines, h.Encoding);
    json["OldHeader"] = text(h.OldHeader);
    json["Body"] = text(h.Body);
    return json.dump();
}
