#pragma once

#include <chrono>
#include <filesystem>
#include <memory>
#include <optional>
#include <string>
#include <vector>

#include "linux/contacts/VCardModule.h"
#include "linux/contacts/VCardText.h"
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
        /// Cards and files that were passed over: the first VCardText::kMostProblems.
        std::vector<Problem> problems;
        /// Why nothing could be read at all: the path is missing or cannot be opened, or the parser cannot be loaded.
        std::optional<std::string> error;
    };

    /// A file beyond this is passed over; bytes. What a card may hold is VCardText's to say.
    static constexpr std::size_t kLargestFile = std::size_t{256} << 20;
    /// And so are files after these many bytes in all.
    static constexpr std::uintmax_t kMostBytes = std::uintmax_t{512} << 20;
    /// Contacts beyond these many are passed over, in however many files they stand.
    static constexpr std::size_t kMostContacts = VCardText::kMostCards;
    /// Computing time that thumbnails of large photos may take in all; contacts after that have none.
    static constexpr std::chrono::seconds kThumbnailTime{10};

    /// Of a folder all its files named *.vcf (not of folders in it); of a file all its cards.
    Result read(const std::filesystem::path& path) const;
    /// Whether a file of a folder is read: "*.vcf", whatever the case.
    static bool isCardFile(const std::filesystem::path& file);
    /// The cards of one text; `file` names it in problems.
    Result readText(const std::string& text, const std::filesystem::path& file) const;

  private:
    class Reading;
};

}  // namespace ktr::linux_
