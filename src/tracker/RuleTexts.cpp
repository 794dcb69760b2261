// SPDX-License-Identifier: MIT
#include "RuleTexts.h"

#include <algorithm>
#include <array>

namespace {

constexpr const char* NoRepair = "Not repaired by any command: the right value is the author's choice.";
constexpr const char* NumbersWhy =
    "The library writes each number in its shortest exact form, so that files compare line by line and "
    "stay small.";
constexpr const char* GeometryWhy = "Renderers and tools that build on the library need geometry they can draw and "
                                    "compute with; such a shape draws wrongly or not at all.";
constexpr const char* PresenceRepair =
    "Not repaired: add the line with the window or quillmark-cli edit. While this finding stands, no other "
    "Tracker rule runs, and fix leaves the file alone.";

constexpr std::array Rules{
    // The save checks and the fix-ups a save offers.
    RuleText{"save.description-length", "The description is longer than 64 characters.",
             "The part description (the first line) has at most 64 characters: code points in a UTF-8 file, bytes in "
             "any other.",
             "64 characters is the limit of an older header standard that many tools still assume. The Parts Tracker "
             "has no length rule, so under check --tracker a longer description is only a warning; a save refuses it "
             "unless the limit is lifted (--no-length-limit, or the preference).",
             "Not repaired: shorten the description, or lift the limit.",
             "0 Technic Beam  3 x  0.5 Liftarm with Boss and Pin Hole and Axle Hole Ends"},
    RuleText{"save.author", "The author line has no real name.",
             "The header has a \"0 Author:\" line with the author's real name.",
             "The library credits every file to its author by name.", "Not repaired: set the author.",
             "0 Author: [ssample]"},
    RuleText{"save.username", "The author line names no user.",
             "The \"0 Author:\" line carries a user name in square brackets after the real name.",
             "The Parts Tracker knows authors by their user name; a save asks before writing a file without one.",
             "Not repaired: set the user name (the preference fills it for new headers).", "0 Author: Sam Sample"},
    RuleText{"save.bfc", "The header has no BFC line.",
             "The header states the file's winding with a \"0 BFC\" line (CERTIFY CCW, CERTIFY CW or NOCERTIFY).",
             "Back-face culling needs to know the winding of every polygon; the library requires the statement.",
             "Not repaired: set the BFC type; the library wants \"0 BFC CERTIFY CCW\".", "a header without 0 BFC"},
    RuleText{"save.license", "The header has no licence line.", "The header has a \"0 !LICENSE\" line.",
             "Files in the library can only be shared under a licence their authors agreed to.",
             "Not repaired by save; when the line is there but not approved, fix sets the current licence "
             "(license.approved).",
             "a header without 0 !LICENSE"},
    RuleText{"save.type", "The header has no part type.",
             "The header has a \"0 !LDRAW_ORG\" line naming the file's type (Part, Subpart, Primitive, ...).",
             "The type decides the folder a file lives in and how the library treats it.",
             "Not repaired: set the part type.", "a header without 0 !LDRAW_ORG"},
    RuleText{"save.needs-work-comment", "A part that needs work has no comment saying what.",
             "A description that says the part needs work comes with at least one \"0 //\" comment.",
             "Whoever takes the part up next needs to know what is left to do.",
             "Not repaired: add a comment that says what needs work.",
             "0 Brick  2 x  4 (Needs Work) with no 0 // line"},
    RuleText{"save.fixup.certify-invertnext", "The body has \"0 BFC CERTIFY INVERTNEXT\".",
             "The body holds \"0 BFC CERTIFY INVERTNEXT\" (any case), a form of INVERTNEXT the BFC rules do not know.",
             "The statement is \"0 BFC INVERTNEXT\"; readers ignore the wrong form and draw the next subfile "
             "inside out.",
             "save --fix (or Yes to the save's question) writes \"0 BFC INVERTNEXT\" where the exact upper-case form "
             "stands.",
             "0 BFC CERTIFY INVERTNEXT"},
    RuleText{"save.fixup.rotation", "The body has \"0 ROTATION\" lines.",
             "The body holds \"0 ROTATION \" (any case): a meta command of editing programs, not of part files.",
             "Part files hold geometry and the library's metas only.",
             "save --fix (or Yes to the save's question) deletes the lines that begin with \"0 ROTATION \".",
             "0 ROTATION CENTER 0 0 0 1 \"Custom\""},
    RuleText{"save.fixup.write", "The body has \"0 WRITE\" lines.",
             "The body holds \"0 WRITE \" (any case), an old form of a comment.",
             "The library writes comments as \"0 //\"; the Tracker refuses \"0 WRITE\" lines.",
             "save --fix (or Yes to the save's question) replaces \"0 WRITE\" by \"0\".", "0 WRITE made by hand"},
    RuleText{"save.fixup.color", "The header has COLOR lines.",
             "The header holds COLOR lines, which belong to model files.",
             "A part is drawn in the colour its user gives it; a colour in its header means nothing to readers.",
             "save --fix (or Yes to the save's question) deletes the COLOR lines.", "0 COLOR 4"},
    // The Parts Tracker's rules.
    RuleText{"authorinvalid", "The author is not written \"Real Name [username]\".",
             "The \"0 Author:\" line is a real name, a user name in square brackets, or both; a user name has "
             "letters, digits, \"_\", \".\" and \"-\" only.",
             "The Tracker links the file to its author's account by the user name.", PresenceRepair,
             "0 Author: Sam Sample [s sample]"},
    RuleText{"bfc", "The first BFC line is not \"0 BFC CERTIFY CCW\".",
             "The header's first BFC line is exactly \"0 BFC CERTIFY CCW\".",
             "Every library file is certified for back-face culling with counter-clockwise winding.",
             "Not repaired: a file of another winding must be checked and its polygons turned by its author.",
             "0 BFC CERTIFY CW"},
    RuleText{"category.invalid", "The category is not an official one.",
             "A part's or shortcut's category (its \"0 !CATEGORY\" line, else the description's first word) is one "
             "of the official categories of category.txt.",
             "Categories sort the library for the programs that list parts.", NoRepair, "0 !CATEGORY Bricks"},
    RuleText{"circularreference", "The file places itself as a subfile.", "No type 1 line names the file itself.",
             "A file that contains itself can never be drawn.", "Not repaired: remove or rename the line.",
             "1 16 0 0 0 1 0 0 0 1 0 0 0 1 3001.dat (in 3001.dat)"},
    RuleText{"description.aliasdesc", "An alias's description does not start with \"=\".",
             "The description of a file of type Alias starts with \"=\".",
             "The library marks aliases so that part lists can hide them.", NoRepair, "0 Brick  2 x  4 (an Alias)"},
    RuleText{"description.invalidchars", "The description holds characters that are not allowed.",
             "The description holds no control or format characters, no private-use or unassigned code points, no "
             "line or paragraph separators.",
             "Such characters are invisible or break lines in the programs that show descriptions.",
             "Not repaired: retype the description.", "0 Brick 2 x 4 with a zero-width space (U+200B) after Brick"},
    RuleText{"description.movedorobsolete", "A moved or obsolete part's description does not start with \"~\".",
             "A part in the category Moved or Obsolete has a description that starts with \"~\".",
             "\"~\" hides a file from the part lists of most programs.", NoRepair, "0 Moved to 3001 (category Moved)"},
    RuleText{"description.patternword", "A pattern's description does not end in \"Pattern\".",
             "A part whose name has a pattern suffix (3001p01.dat) has a description that ends in \"Pattern\", "
             "maybe followed by a note in brackets; stickers, moved parts and colour combinations are exempt.",
             "Part lists find patterned parts by the word.",
             "quillmark-cli fix adds \" Pattern\" at the end of the description.", "0 Brick  2 x  4 with Red Stripe"},
    RuleText{"description.subpartdesc", "A subpart's description does not start with \"~\".",
             "The description of a Subpart starts with \"~\".",
             "\"~\" keeps subparts out of the part lists: they are pieces of parts, not parts.", NoRepair,
             "0 Brick  2 x  4 without Studs (a Subpart)"},
    RuleText{"description.thirdpartydesc", "A third-party part's description does not start with \"|\".",
             "A part whose name starts with \"t\" has a description that starts with \"|\".",
             "The library marks parts that are not made by LEGO.", NoRepair, "0 Tyre 30.4 x 14 (in t1234.dat)"},
    RuleText{"history.invalid", "A history line is not in the library's form.",
             "Each \"0 !HISTORY\" line is \"0 !HISTORY YYYY-MM-DD [user] comment\" (or {Real Name} for the user).",
             "The history tells who changed what and when; tools read it.",
             "Not repaired: rewrite the line; quillmark-cli edit --add-history writes new lines in this form.",
             "0 !HISTORY 2024-1-5 [ssample] Fixed"},
    RuleText{"keywords.patternset", "A pattern has no keyword naming its set.",
             "A pattern (not Modulex or Moved) has a \"0 !KEYWORDS\" entry starting with \"Set \", \"CMF\" or "
             "\"Build-A-Minifigure\".",
             "Patterns are found by the set they came in.", "Not repaired: add the keyword of the set.",
             "3001p01.dat without 0 !KEYWORDS Set 6080"},
    RuleText{"license.approved", "The licence is not one the library accepts.",
             "The \"0 !LICENSE\" line is one of the licences the library accepts today (CC BY 4.0, CC BY 2.0 and "
             "CC BY 4.0, or CC0 1.0, each \": see CAreadme.txt\").",
             "The library can only publish files under the licences its contributors agreed to.",
             "quillmark-cli fix sets \"0 !LICENSE Licensed under CC BY 4.0 : see CAreadme.txt\".",
             "0 !LICENSE Redistributable under CCAL version 2.0 : see CAreadme.txt"},
    RuleText{"line.colinear", "A triangle's or quad's corners lie on one line.",
             "No corner of a triangle or quad has an angle above 179.9 degrees or below 0.025 degrees.", GeometryWhy,
             "Not repaired: move the points.", "3 16 0 0 0 1 0 0 2 0.001 0"},
    RuleText{"line.identicalpoints", "Two points of a line that must differ are the same.",
             "A line's two ends, a triangle's or quad's corners, and an optional line's two control points are "
             "different points.",
             GeometryWhy, "Not repaired: move or remove the line.", "3 16 0 0 0 1 0 0 1 0 0"},
    RuleText{"line.invalid", "The line is not a valid LDraw line.",
             "Every line has the shape of its type: geometry lines their colour and count of numbers, meta lines "
             "one of the library's metas, comments \"0 // text\".",
             "Programs that read the library skip or misread any other line.", "Not repaired: rewrite the line.",
             "3 16 0 0 0 1 0 0 0 1"},
    RuleText{"line.invalidcolor", "The colour is not defined, or a subfile uses the edge colour.",
             "A geometry line's colour is a code of LDConfig.ldr (or a direct 0x2RRGGBB colour); a subfile is not "
             "placed in the edge colour 24.",
             "Readers know the colours of LDConfig.ldr only.", "Not repaired: choose a colour.",
             "3 9999 0 0 0 1 0 0 0 1 0"},
    RuleText{"line.invalidcolor24", "A triangle or quad uses the edge colour 24.",
             "Triangles and quads (types 3 and 4) are not in colour 24.",
             "Colour 24 is the edge colour of lines; a surface in it draws as an outline colour.",
             "Not repaired: choose a colour (16 for the part's own).", "3 24 0 0 0 1 0 0 0 1 0"},
    RuleText{"line.invalidcoloredlines", "A line or optional line does not use the edge colour 24.",
             "Lines and optional lines (types 2 and 5) are in colour 24.",
             "Edges are drawn in the edge colour that matches the part's colour.",
             "quillmark-cli fix --only line.invalidcoloredlines sets the colour of those lines to 24; it is off by "
             "default, since an edge in another colour may be meant.",
             "2 16 0 0 0 1 0 0"},
    RuleText{"line.notconvex", "A quad is concave or crossed.", "A quad (type 4) is convex: not a dart, not a bow-tie.",
             GeometryWhy, "Not repaired: reorder its points or split it into triangles.",
             "4 16 0 0 0 1 0 0 0 1 0 1 1 0"},
    RuleText{"line.notcoplaner", "A quad is not flat.", "A quad (type 4) bends by at most 3 degrees.", GeometryWhy,
             "Not repaired: split it into two triangles.", "4 16 0 0 0 1 0 0 1 1 0.1 0 1 0"},
    RuleText{"line.singular", "A subfile's placement matrix is singular.",
             "The 3 x 3 matrix of a type 1 line has a determinant other than zero (within 1e-11).",
             "A singular matrix flattens the subfile; its normals cannot be computed.",
             "Not repaired: give the subfile a real placement.", "1 16 0 0 0 1 0 0 0 0 0 0 0 1 stud.dat"},
    RuleText{"missing", "A line the library requires is missing.",
             "The header has a description, a \"0 Name:\" line, a \"0 !LDRAW_ORG\" line of a known type, a "
             "\"0 !LICENSE\" line and an \"0 Author:\" line.",
             "Without them the Tracker cannot file, credit or publish the part.", PresenceRepair,
             "a file without 0 Name:"},
    RuleText{"name.filename", "The name in the header is not the file's name.",
             "The \"0 Name:\" line, after its folder, is the file's own name (letter case aside).",
             "Files refer to each other by the name; a wrong one breaks those references.",
             "Not repaired by default: quillmark-cli edit --name-from-path writes the file's name.",
             "0 Name: 3002.dat (in 3001.dat)"},
    RuleText{"name.flex", "A flexible section's name does not end in \"k\" and two characters.",
             "A Flexible_Section in an official category has a name ending in \"k\" and two letters or digits.",
             "The library names the sections of flexible parts in one scheme.", "Not repaired: rename the file.",
             "0 Name: 73590a.dat (a Flexible_Section)"},
    RuleText{"name.invalidchars", "The name holds characters that are not allowed.",
             "The \"0 Name:\" line holds no control or format characters, no private-use or unassigned code "
             "points, no line or paragraph separators.",
             "Names are file names on every system that uses the library.", "Not repaired: rename the file.",
             "0 Name: 3001.dat with a zero-width space (U+200B) before the point"},
    RuleText{"name.xparts", "The name starts with \"x\".", "A file's name does not start with \"x\".",
             "Names starting with \"x\" were given to parts of unknown number and are no longer accepted.",
             "Not repaired: give the part its number.", "0 Name: x123.dat"},
    RuleText{"numbers.decimalprecision", "A number has more than 5 decimal places.",
             "On a geometry line (or one inside \"0 !:\"), the first number with five or more decimals has exactly "
             "five; the Parts Tracker looks no further along the line.",
             NumbersWhy,
             "quillmark-cli fix rounds the line's numbers to five decimals, keeping a line whose rounding would give "
             "it a geometry finding.",
             "3 16 0.123456 0 0 1 0 0 0 1 0"},
    RuleText{"numbers.leadingzeros", "A number starts with a needless zero.",
             "No number on a geometry line (or one inside \"0 !:\") starts with a zero before other digits, the "
             "colour included; the line's last word is not examined.",
             NumbersWhy, "quillmark-cli fix drops the needless zeros: \"007\" becomes \"7\", \"-00.5\" \"-0.5\".",
             "3 16 01 0 0 0 0 0 0 2 0"},
    RuleText{"numbers.trailingzeros", "A number ends in a needless zero.",
             "No decimal fraction on a geometry line (or one inside \"0 !:\") ends in 0; the file as a whole gets "
             "one more finding when any of its geometry lines has one.",
             NumbersWhy, "quillmark-cli fix drops the zeros, and the point when nothing is left after it.",
             "2 24 0 0 0 1.50 0 0"},
    RuleText{"obsoleteimproper", "The category and the description disagree about the part being obsolete.",
             "A part is in the category Obsolete exactly when its description says \"(Obsolete)\" or starts with "
             "\"~Obsolete\".",
             "Readers hide obsolete parts by either sign; the two must agree.", NoRepair,
             "0 ~Obsolete Brick (category Brick)"},
    RuleText{"type.alias", "An Alias that is not a Part or Shortcut.",
             "The qualifier Alias is given to a Part or a "
             "Shortcut only.",
             "An alias stands for a whole part under another number.", NoRepair,
             "0 !LDRAW_ORG Subpart Alias UPDATE 2024-01"},
    RuleText{"type.flex", "A Flexible_Section that is not a Part.",
             "The qualifier Flexible_Section is given to a Part only.",
             "Flexible sections are the library's pieces of flexible parts, filed as parts.", NoRepair,
             "0 !LDRAW_ORG Subpart Flexible_Section UPDATE 2024-01"},
    RuleText{"type.path", "The name's folder is not the one the type wants.",
             "The \"0 Name:\" line starts with the folder of the file's type: none for parts, \"s\\\" for subparts, "
             "\"48\\\" and \"8\\\" for those primitives.",
             "The library's folders follow the types; readers find files by the name.",
             "quillmark-cli fix writes the file's name after the folder its type wants.",
             "0 Name: 3001s01.dat (a Subpart)"},
    RuleText{"type.phycolor", "Physical_Colour outside the category Obsolete.",
             "The qualifier Physical_Colour is given to obsolete parts only.",
             "Parts no longer carry their colour in the file; old ones that did are obsolete.", NoRepair,
             "0 !LDRAW_ORG Part Physical_Colour UPDATE 2024-01"},
    RuleText{"warning.descriptionnumbers", "A number in the description has one blank before it.",
             "Numbers of dimensions in the description have two blanks before them (\"Brick  1 x  2\").",
             "Two blanks make part lists sort \"1 x  2\" before \"1 x 10\".",
             "quillmark-cli fix adds the second blank before each such number.", "0 Brick 2 x 4"},
    RuleText{"warning.minifigcategory", "The category is retired.",
             "A part's category is not a retired one (Minifig, Forklift, ...).",
             "Retired categories were split or merged into others.",
             "quillmark-cli fix sets the active category that follows from the retired one or the description "
             "(Forklift becomes Vehicle).",
             "0 !CATEGORY Minifig"},
    RuleText{"warning.notcoplaner", "A quad is not quite flat.",
             "A quad (type 4) that bends by more than 1 and at most 3 degrees.", GeometryWhy,
             "Not repaired: split it into two triangles, or flatten it.", "4 16 0 0 0 1 0 0 1 1 0.03 0 1 0"},
    RuleText{"warning.previewinvalid", "The preview line is not one the library allows.",
             "A \"0 !PREVIEW\" line has a colour, a position and one of the ten rotations the library allows.",
             "Preview images of the library are rendered from these views only.", "Not repaired: choose a rotation.",
             "0 !PREVIEW 16 0 0 0 1 0 0 0 2 0 0 0 1"},
    RuleText{"warning.stickercolor", "A sticker shortcut places its sticker in a colour other than 16.",
             "In a sticker shortcut, the sticker is placed in colour 16.",
             "A sticker in a fixed colour hides the surface it is meant to show through.",
             "Not repaired: check the colour is meant.", "1 4 0 0 0 1 0 0 0 1 0 0 0 1 s\\sticker.dat"},
};

void appendSection(std::string& text, const char* heading, const char* body)
{
    text.append(heading).append(":\n  ").append(body).append("\n");
}

} // namespace

std::span<const RuleText> RuleTexts() { return Rules; }

const RuleText* FindRuleText(std::string_view id)
{
    const auto found = std::find_if(Rules.begin(), Rules.end(), [id](const RuleText& rule) { return rule.id == id; });
    return found == Rules.end() ? nullptr : &*found;
}

std::string RuleAnchor(const RuleText& rule) { return rule.id; }

std::string RuleDescription(const RuleText& rule) { return std::string(rule.checks) + ' ' + rule.why; }

std::string ExplainText(const RuleText& rule)
{
    std::string text = std::string(rule.id) + ": " + rule.title + "\n\n";
    appendSection(text, "Checks", rule.checks);
    appendSection(text, "Why", rule.why);
    appendSection(text, "Repair", rule.repair);
    appendSection(text, "Example", rule.example);
    return text;
}

std::string RuleMarkdown(const RuleText& rule)
{
    std::string text = "<a id=\"" + RuleAnchor(rule) + "\"></a>\n\n## `" + rule.id + "`\n\n" + rule.title + "\n\n";
    text.append("- **Checks:** ").append(rule.checks).append("\n");
    text.append("- **Why:** ").append(rule.why).append("\n");
    text.append("- **Repair:** ").append(rule.repair).append("\n");
    text.append("- **Example:** `").append(rule.example).append("`\n");
    return text;
}

std::string RulesMarkdown()
{
    std::string text = "# The ids of quillmark-cli's findings\n\n"
                       "Generated by `quillmark-cli explain --markdown > docs/rules.md`; do not edit by hand.\n"
                       "`save.*` are the save checks and the fix-ups a save offers; the others are the Parts "
                       "Tracker's rules, by the Tracker's own ids.\n";
    for (const auto& rule : Rules)
        text.append("\n").append(RuleMarkdown(rule));
    return text;
}
