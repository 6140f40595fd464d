#pragma once

#include <filesystem>
#include <string>
#include <string_view>
#include <vector>

namespace ktr::documents {

/// Files that a user asked for, written all or none: each is written beside its place and brought to the disk, and only
/// when all are whole do they take their places. Until then whatever lay there is untouched, and what fails leaves
/// nothing behind. One thread at a time; it waits for the disk.
class StagedFiles {
  public:
    StagedFiles() = default;
    /// Removes what did not take its place.
    ~StagedFiles();
    StagedFiles(const StagedFiles&) = delete;
    StagedFiles& operator=(const StagedFiles&) = delete;

    /// Why nothing may be written in this place: a folder, a pipe, a device. Empty when it may.
    static std::string refusal(const std::filesystem::path& file);
    /// Writes the file beside its place. Empty when done, else one line that says what failed. A link is followed; a
    /// file keeps its mode, a new one gets the usual one.
    std::string add(const std::filesystem::path& file, std::string_view bytes);
    /// Puts all in their places. Empty when done, else one line; what lay in the places is there again then.
    std::string commit();

  private:
    struct File {
        std::filesystem::path place;
        std::filesystem::path beside;
        bool replaces = false;  ///< something lies in its place
        bool exchanged = false;
        bool moved = false;
    };
    /// 0 or the errno of the failure.
    int put(File& file, bool canGoBack);
    void takeBack();

    std::vector<File> files_;
};

}  // namespace ktr::documents
