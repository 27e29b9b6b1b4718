#pragma once

#include <optional>
#include <string>

namespace ryn {

/// Lets the user choose a file to write.
class FileChoicePort {
  public:
    struct SaveRequest {
        std::string defaultExtension; ///< appended to a name without one
        std::string filter;           ///< "text|pattern|text|pattern||"
        std::string suggestedName;
    };

    virtual ~FileChoicePort() = default;
    /// Asks before an existing file is replaced. Nothing when the user cancels.
    virtual std::optional<std::string> ChooseFileToSave(const SaveRequest& request) = 0;
};

} // namespace ryn
