#include "snippet.h"

#include <algorithm>
#include <stdexcept>

namespace messagegen {

namespace {

constexpr std::string_view kIndentation = "  ";

std::string_view takeLine(std::string_view& text) {
  const std::string_view line = text.substr(0, text.find('\n'));
  text.remove_prefix(line.size() == text.size() ? line.size() : line.size() + 1);
  return line;
}

std::size_t indentationOf(std::string_view line) {
  const std::size_t width = line.find_first_not_of(' ');
  return width == std::string_view::npos ? line.size() : width;
}

class Expansion {
 public:
  Expansion(std::string_view snippet, const Variables& variables) : snippet_(snippet), variables_(variables) {}

  std::string run() {
    std::string_view rest = snippet_;
    if (rest.starts_with('\n')) rest.remove_prefix(1);
    const std::size_t margin = indentationOf(rest.substr(0, rest.find('\n')));
    while (!rest.empty()) {
      const std::string_view line = takeLine(rest);
      if (rest.empty() && indentationOf(line) == line.size()) break;
      addLine(line.substr(std::min(margin, indentationOf(line))));
    }
    return std::move(out_);
  }

 private:
  [[nodiscard]] const std::string& valueOf(std::string_view name) const {
    const auto found = variables_.find(name);
    if (found == variables_.end()) {
      throw std::logic_error("no variable '" + std::string(name) + "' for the snippet\n" + std::string(snippet_));
    }
    return found->second;
  }

  void addLine(std::string_view line) {
    const std::string_view content = line.substr(indentationOf(line));
    const bool isPlaceholder =
        content.size() > 2 && content.starts_with('$') && content.find('$', 1) == content.size() - 1;
    if (isPlaceholder) {
      addBlock(valueOf(content.substr(1, content.size() - 2)), line.substr(0, line.size() - content.size()));
    } else {
      addFilled(line);
      out_ += '\n';
    }
  }

  void addBlock(std::string_view block, std::string_view indentation) {
    while (!block.empty()) {
      const std::string_view line = takeLine(block);
      if (!line.empty()) out_ += indentation;
      out_ += line;
      out_ += '\n';
    }
  }

  void addFilled(std::string_view line) {
    while (!line.empty()) {
      const std::size_t start = line.find('$');
      out_ += line.substr(0, start);
      if (start == std::string_view::npos) return;
      const std::size_t end = line.find('$', start + 1);
      if (end == std::string_view::npos) {
        throw std::logic_error("a lone '$' in the snippet\n" + std::string(snippet_));
      }
      const std::string_view name = line.substr(start + 1, end - start - 1);
      out_ += name.empty() ? "$" : valueOf(name);
      line.remove_prefix(end + 1);
    }
  }

  std::string_view snippet_;
  const Variables& variables_;
  std::string out_;
};

/// Behind the parenthesis that closes the first one.
std::size_t endOfCondition(std::string_view statement) {
  std::size_t end = statement.find('(');
  int open = 0;
  do {
    open += statement[end] == '(' ? 1 : statement[end] == ')' ? -1 : 0;
    ++end;
  } while (open > 0);
  return end;
}

std::string fitted(std::string_view line) {
  if (kIndentation.size() + line.size() <= kLineWidth) return std::string(line) + '\n';
  const bool isStatement = line.starts_with("if (");
  const std::size_t head = isStatement ? endOfCondition(line) : line.find(" { ");
  if (head == std::string_view::npos) return std::string(line) + '\n';
  std::string_view action = line.substr(head + (isStatement ? 1 : 3));
  if (!isStatement) action.remove_suffix(2);
  return expand("$head$ {\n  $action$\n}\n",
                {{"head", std::string(line.substr(0, head))}, {"action", std::string(action)}});
}

}  // namespace

std::string expand(std::string_view snippet, const Variables& variables) {
  return Expansion(snippet, variables).run();
}

std::string expandInline(std::string_view snippet, const Variables& variables) {
  std::string line = expand(snippet, variables);
  if (line.ends_with('\n')) line.pop_back();
  return line;
}

std::string expandToFit(std::string_view snippet, const Variables& variables) {
  const std::string expanded = expand(snippet, variables);
  std::string out;
  for (std::string_view rest = expanded; !rest.empty();)
    out += fitted(takeLine(rest));
  return out;
}

}  // namespace messagegen
