#pragma once

#include <string>

namespace pelorus {

/// What the save screen asks of the application object.
class SaveHost {
public:
    virtual ~SaveHost() = default;
    virtual void closeSaveView() = 0;
    virtual void snapshotSaved(const std::string& path) = 0;
    /// With one button, "Close", and nothing that follows it.
    virtual void showAlert(const std::string& title, const std::string& message) = 0;
};

} // namespace pelorus
