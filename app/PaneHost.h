#pragma once

namespace pelorus {

/// What a pane asks of the application object.
class PaneHost {
public:
    virtual ~PaneHost() = default;
    virtual bool allowSaveButton() const = 0;
    virtual void showSaveView() = 0;
};

} // namespace pelorus
