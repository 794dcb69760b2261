// SPDX-License-Identifier: MIT
#pragma once

#include <QString>
#include <optional>
#include <string>

#include "HeaderData.h"

// The window's one place that converts between the file's bytes and what the widgets show: a
// UTF-8 file is shown as UTF-8, any other as ISO-8859-1. Nothing is ever replaced silently.

QString ToWidget(const std::string& bytes, TextEncoding encoding);
// The bytes for the file, or nullopt when the text holds a character the encoding cannot hold.
std::optional<std::string> FromWidget(const QString& text, TextEncoding encoding);

// The same for texts that travel through the dialogs seam, which speaks UTF-8.
std::string ToUtf8(const std::string& bytes, TextEncoding encoding);
std::optional<std::string> FromUtf8(const std::string& utf8, TextEncoding encoding);

// A list-file entry: UTF-8 where its bytes allow it, else ISO-8859-1.
QString ListEntryToWidget(const std::string& bytes);

// The message shown when a typed character does not fit the file's encoding.
std::string UnencodableMessage();
