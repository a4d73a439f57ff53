#pragma once

#include "IColorInformation.h"

namespace Pigmo {

// The palette control's view of its owner: the colors of a book, the pick and the scroll position.
// Nothing is deleted through it.
class IColorPalletteUser {
public:
    virtual unsigned int GetColorCount() = 0;
    // The color at index, valid until the owner's colors change; index must be below the count.
    virtual IColorInformation* GetColor(unsigned int index) = 0;
    // Picks a color; -1 clears the pick.
    virtual void SelectColor(int index) = 0;
    virtual int GetSelectedIndex() = 0;
    virtual int SetScrollPosition(int index) = 0;
    virtual int GetScrollPosition() = 0;

protected:
    ~IColorPalletteUser() = default;
};

}  // namespace Pigmo
