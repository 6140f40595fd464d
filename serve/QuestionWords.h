#pragma once

#include <QStringList>
#include <initializer_list>
#include <string>

namespace ktr::serve {

/// The words of a question, without regard to case and punctuation; what stands in an e-mail address or a number stays.
/// An apostrophe joins: "where's" is one word. Any thread.
class QuestionWords {
  public:
    explicit QuestionWords(const std::string& text);

    const QStringList& words() const { return words_; }
    bool hasAny(std::initializer_list<const char*> wanted) const;
    /// All words of `part` follow each other; none of nothing.
    bool holds(const QuestionWords& part) const;
    bool holds(const char* part) const { return holds(QuestionWords(part)); }
    bool startsWithAny(std::initializer_list<const char*> wanted) const;

    static bool isAny(const QString& word, std::initializer_list<const char*> wanted);

  private:
    QStringList words_;
};

}  // namespace ktr::serve
