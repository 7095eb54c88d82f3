#include "support/ui/HeadlessTestSupport.h"

namespace norvik::ui::test {

HeadlessFixture* HeadlessFixture::sCurrent = nullptr;

HeadlessFixture::HeadlessFixture() : mLayer(mSystem.GetLayer()) {
  sCurrent = this;
  mLayer.SetWindowProcedure(&HeadlessFixture::Procedure);
}

HeadlessFixture::~HeadlessFixture() {
  mHandler = nullptr;
  for (OS_WindowHandle window : mLayer.EnumerateWindows()) mLayer.DestroyWindow(window);
  sCurrent = nullptr;
}

std::intptr_t HeadlessFixture::Procedure(OS_WindowHandle inWindow, unsigned inMessage, std::uintptr_t inWParam,
                                         std::intptr_t inLParam) {
  HeadlessFixture* self = sCurrent;
  if (!self) return 0;
  RecordedMessage record{inWindow, inMessage, inWParam, inLParam, self->mLayer.GetMessageTime()};
  self->mMessages.push_back(record);
  if (self->mHandler) {
    // Copied, so that a handler may replace itself.
    Handler handler = self->mHandler;
    if (std::optional<std::intptr_t> answer = handler(record)) return *answer;
  }
  return self->mLayer.DefaultWindowProcedure(inWindow, inMessage, inWParam, inLParam);
}

OS_WindowHandle HeadlessFixture::MakeWindow(const OS_Rect& inRect, std::uint32_t inStyle, std::uint32_t inExStyle,
                                            OS_WindowHandle inParent, std::uint32_t inClassStyle) {
  OS_WindowCreateParams params;
  params.rect = inRect;
  params.style = inStyle;
  params.exStyle = inExStyle;
  params.parent = inParent;
  params.classStyle = inClassStyle;
  return mLayer.CreateWindow(params);
}

OS_WindowHandle HeadlessFixture::MakeChild(OS_WindowHandle inParent, const OS_Rect& inRect, std::uint32_t inStyle) {
  return MakeWindow(inRect, inStyle, 0, inParent);
}

std::vector<RecordedMessage> HeadlessFixture::Messages(unsigned inMessage, OS_WindowHandle inWindow) const {
  std::vector<RecordedMessage> result;
  for (const RecordedMessage& record : mMessages)
    if (record.message == inMessage && (inWindow == 0 || record.window == inWindow)) result.push_back(record);
  return result;
}

std::vector<unsigned> HeadlessFixture::NumbersOf(OS_WindowHandle inWindow) const {
  std::vector<unsigned> result;
  for (const RecordedMessage& record : mMessages)
    if (record.window == inWindow && record.message != kOSMsgSetCursor && record.message != kOSMsgPaint)
      result.push_back(record.message);
  return result;
}

}  // namespace norvik::ui::test
