// SPDX-License-Identifier: MIT
#pragma once

#include <string>

class Dialogs;

// The file name of a path: its last "/"-separated component, after trimming blanks. A blank
// path is an error, reported through dialogs; the result is then empty.
std::string DateiNurName(const std::string& path, Dialogs& dialogs);

// The folder of a path, without a trailing "/". The root of an absolute path stays: the folder
// of "/home/ann/3001.dat" is "/home/ann" and of "/3001.dat" it is "/". A path without "/" has an
// empty folder, meaning the current one.
std::string DateiNurPfad(const std::string& path);

// A path as a full path: one that does not start at "/" is taken from the working folder. Links
// are not resolved, so the path stays the one the user named; "." components are dropped.
std::string AbsolutePath(const std::string& path);
