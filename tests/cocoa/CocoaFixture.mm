#include "tests/cocoa/CocoaFixture.h"

#include <utility>

/// What a timer calls.
@interface TestAction : NSObject {
@public
    void* action; ///< a std::function<void()>, which Objective-C cannot describe; owned
}
- (void)act:(id)timer;
@end

@implementation TestAction
- (void)act:(id)timer {
    (*static_cast<std::function<void()>*>(action))();
}
- (void)dealloc {
    delete static_cast<std::function<void()>*>(action);
    [super dealloc];
}
@end

namespace {

quarn::SessionOptions optionsFor(const std::string& language) {
    quarn::SessionOptions options;
    options.locale_folders = {HOST_LOCALE_FOLDER};
    options.language = language;
    return options;
}

NSAutoreleasePool* startedPool() {
    NSAutoreleasePool* const pool = [[NSAutoreleasePool alloc] init];
    [NSApplication sharedApplication];
    return pool;
}

} // namespace

CocoaTest::CocoaTest(const std::string& language)
    : pool(startedPool()), session(front_end, optionsFor(language)),
      dialog(120, L"Turn", list({L"Clockwise", L"AntiClockwise"}), 1,
             list({L"jpg", L"png", L"bmp", L"tga"}), 0,
             list({L"Wireframe", L"Shaded", L"Rendered"}), 2,
             list({L"Top", L"Front", L"Right", L"Perspective"}), 3, nullptr) {}

CocoaTest::~CocoaTest() {
    [pool drain];
}

KM_ClassArray<KM_wString> CocoaTest::list(std::initializer_list<const wchar_t*> texts) {
    KM_ClassArray<KM_wString> made;
    for (const wchar_t* text : texts) {
        made.Append(text);
    }
    return made;
}

void onceTheWindowIsThere(std::function<void()> action) {
    TestAction* const target = [[[TestAction alloc] init] autorelease];
    target->action = new std::function<void()>(std::move(action));
    NSTimer* const timer = [NSTimer timerWithTimeInterval:0.3
                                                   target:target
                                                 selector:@selector(act:)
                                                 userInfo:nil
                                                  repeats:NO];
    [[NSRunLoop currentRunLoop] addTimer:timer forMode:NSModalPanelRunLoopMode];
}
