#pragma once

#include <cstddef>
#include <string>
#include <string_view>

namespace ktr::documents {

/// Of a line of an error or of the log, bytes.
inline constexpr std::size_t kLongestLine = 4000;

/// Any text, fit to be printed as one line: nothing in it ends the line, steers a terminal or turns the order of what
/// follows. Control characters of both ranges, line and paragraph separators and directional marks are escaped
/// ("\n", "\x1b", "\u009b", "\u202e"), malformed UTF-8 is replaced, what is beyond `longest` bytes is cut off. Isolates
/// that `inQuotes` made stay. Everything that is printed passes here once, no matter who wrote it.
std::string forLine(std::string_view text, std::size_t longest = kLongestLine);

/// A text from outside inside a line of ours: in quotes, escaped like `forLine`, quotes and backslashes too, shortened
/// to about `longest` bytes; one that runs from right to left is isolated, so that it does not turn the rest around.
std::string inQuotes(std::string_view text, std::size_t longest = 60);

/// The text with a blank for each character that would end a line, steer a terminal or override directions: for lines
/// that are read aloud, where an escape would be spelt out.
std::string withoutControls(std::string_view text);

/// The text as one word of a command that somebody may paste into a shell: in single quotes, in which nothing is
/// expanded or run, without what would end the line or steer the terminal.
std::string asShellWord(std::string_view text);

/// JSON fit to be printed: what would steer a terminal or override directions inside its strings becomes an escape,
/// which reads as the same text.
std::string jsonForTerminal(std::string_view json);

}  // namespace ktr::documents
