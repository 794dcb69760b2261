// SPDX-License-Identifier: MIT
#include "FieldsJson.h"

#include <nlohmann/json.hpp>

#include "Text.h"

namespace {

nlohmann::json textList(const EntryList& list)
{
    auto array = nlohmann::json::array();
    for (const auto entry : list)
        array.push_back(Latin1ToUtf8(entry));
    return array;
}

} // namespace

std::string TextForJson(const std::string& path) { return IsValidUtf8(path) ? path : Latin1ToUtf8(path); }

std::string FieldsJson(const HeaderData& h)
{
    nlohmann::ordered_json json;
    json["FilePath"] = TextForJson(h.FilePath);
    json["FileFolder"] = TextForJson(h.FileFolder);
    json["PartName"] = Latin1ToUtf8(h.PartName);
    json["PartDescription"] = Latin1ToUtf8(h.PartDescription);
    json["NeedsWork"] = h.NeedsWork;
    json["ParsedRealName"] = Latin1ToUtf8(h.ParsedRealName);
    json["AuthorRealName"] = Latin1ToUtf8(h.AuthorRealName);
    json["AuthorUserName"] = Latin1ToUtf8(h.AuthorUserName);
    json["PartType"] = Latin1ToUtf8(h.PartType);
    json["UpdateTag"] = Latin1ToUtf8(h.UpdateTag);
    json["License"] = Latin1ToUtf8(h.License);
    json["Bfc"] = Latin1ToUtf8(h.Bfc);
    json["Category"] = Latin1ToUtf8(h.Category);
    json["Keywords"] = textList(h.Keywords);
    json["History"] = textList(h.History);
    json["Comments"] = textList(h.Comments);
    json["HelpLines"] = textList(h.HelpLines);
    json["CmdLines"] = textList(h.CmdLines);
    json["ColorLines"] = textList(h.ColorLines);
    json["OldHeader"] = Latin1ToUtf8(h.OldHeader);
    json["Body"] = Latin1ToUtf8(h.Body);
    return json.dump();
}
