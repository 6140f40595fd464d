#pragma once

#include <filesystem>
#include <memory>
#include <optional>
#include <string>
#include <vector>

#include "linux/contacts/VCardModule.h"
#include "platform/contacts/Contact.h"

namespace ktr::linux_ {

/// Reads contacts from vCards. Loads libktr-contacts.so when it first meets a card. Any thread, one at a time.
class VCardReader {
  public:
    struct Problem {
        std::filesystem::path file;
        std::size_t line = 0;  ///< of the card's first line, counted from 1; 0: the file itself
        std::string message;
    };
    struct Result {
        /// In the order of the files' names, and of the cards in them.
        std::vector<std::shared_ptr<platform::Contact>> contacts;
        /// Cards and files that were passed over.
        std::vector<Problem> problems;
        /// Why nothing could be read at all: the path is missing or cannot be opened, or the parser cannot be loaded.
        std::optional<std::string> error;
    };

    /// A file beyond this is passed over; bytes.
    static constexpr std::uintmax_t kLargestFile = std::uintmax_t{256} << 20;
    /// A card beyond this is passed over; bytes.
    static constexpr std::size_t kLargestCard = std::size_t{16} << 20;

    /// Of a folder all its files named *.vcf (not of folders in it); of a file all its cards.
    Result read(const std::filesystem::path& path) const;
    /// The cards of one text; `file` names it in problems.
    Result readText(const std::string& text, const std::filesystem::path& file) const;

  private:
    void readFile(const std::filesystem::path& file, Result& result) const;
    void readCards(const std::string& text, const std::filesystem::path& file, Result& result) const;
};

}  // namespace ktr::linux_
