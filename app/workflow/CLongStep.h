#pragma once

#include "CGaitConvertContent.h"

namespace gw {

/// Thrown by a progress report if the user has canceled the step.
struct CCanceled
{
};

/// A step that shows its progress in the title and that the user may cancel.
class CGaitConvertContent::CLongStep
{
public:
    explicit CLongStep(CGaitConvertContent& content) : content_(content) { content_.m_bCancelable = true; }
    ~CLongStep();
    CLongStep(const CLongStep&) = delete;
    CLongStep& operator=(const CLongStep&) = delete;

private:
    CGaitConvertContent& content_;
};

} // namespace gw
