// SPDX-License-Identifier: MIT
#include "FileText.h"

#include "Dialogs.h"
#include "Text.h"

namespace {

QString fromUtf8(const std::string& utf8)
{
    return QString::fromUtf8(utf8.data(), static_cast<qsizetype>(utf8.size()));
}

} // namespace

QString ToWidget(const std::string& bytes, TextEncoding encoding)
{
    if (encoding == TextEncoding::Utf8)
        return fromUtf8(bytes);
    return QString::fromLatin1(bytes.data(), static_cast<qsizetype>(bytes.size()));
}

std::optional<std::string> FromWidget(const QString& text, TextEncoding encoding)
{
    if (encoding == TextEncoding::Utf8)
        return text.toStdString();
    for (const QChar c : text)
        if (c.unicode() > 0xFF)
            return std::nullopt;
    return text.toLatin1().toStdString();
}

std::string ToUtf8(const std::string& bytes, TextEncoding encoding) { return ToWidget(bytes, encoding).toStdString(); }

std::optional<std::string> FromUtf8(const std::string& utf8, TextEncoding encoding)
{
    return FromWidget(fromUtf8(utf8), encoding);
}

QString ListEntryToWidget(const std::string& bytes) { return ToWidget(bytes, EncodingOf(bytes)); }

std::string UnencodableMessage()
{
    return Translatable(
        "Messages",
        "This file is written in ISO-8859-1, which cannot hold a character you typed.") "\r\n" Translatable("Messages",
                                                                                                            "The text "
                                                                                                            "was not "
                                                                                                            "changed.");
}
