#pragma once

namespace pelorus {

/// The preferences of the home-screen shell, an application of its own.
class HomeScreenPreferences {
public:
    virtual ~HomeScreenPreferences() = default;
    /// Sets a boolean, synchronizes the store and tells the home-screen shell.
    virtual void setBoolean(const char* key, bool truth) = 0;
};

/// Keeps them in the user's settings, and tells on the session bus where there is one.
class LinuxHomeScreenPreferences : public HomeScreenPreferences {
public:
    void setBoolean(const char* key, bool truth) override;
};

} // namespace pelorus
