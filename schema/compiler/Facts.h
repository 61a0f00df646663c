#pragma once

#include <string>
#include <vector>

namespace compiler {

/// The stub in MOF of a facts file: a class a paragraph, `NAME`, `NAME < SUPERCLASS`, ` association` behind it; below
/// it, indented, `[key] TYPE [ref] NAME[[]] [= NUMBER]` for a property and `TYPE NAME([in] [out] TYPE [ref] NAME, ...)`
/// for a method; `#` starts a comment. Throws mof::MofError.
std::string stub(const std::string& text, const std::string& file);

/// The words of a list file, without comments.
std::vector<std::string> wordsOf(const std::string& text);

} // namespace compiler
