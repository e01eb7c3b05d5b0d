#include "editor/EditorWindow.h"

#include "cli/Failure.h"

#import <AppKit/AppKit.h>

#include <algorithm>

@interface ZebhostWindowDelegate : NSObject <NSWindowDelegate>
@property(nonatomic) BOOL closed;
@end

@implementation ZebhostWindowDelegate

- (BOOL)windowShouldClose:(NSWindow*)sender
{
    self.closed = YES;
    return NO;
}

@end

namespace zebhost
{

namespace
{

Picture ToPicture(NSBitmapImageRep* image)
{
    Picture picture{static_cast<int>([image pixelsWide]), static_cast<int>([image pixelsHigh]), {}};
    for (int y = 0; y < picture.height; ++y)
    {
        @autoreleasepool // Two colours a pixel would be kept to the end of the picture
        {
            for (int x = 0; x < picture.width; ++x)
            {
                NSColor* colour = [[image colorAtX:x y:y] colorUsingColorSpace:[NSColorSpace sRGBColorSpace]];
                for (const CGFloat part : {[colour redComponent], [colour greenComponent], [colour blueComponent]})
                {
                    picture.pixels.push_back(static_cast<std::uint8_t>(std::clamp(part, 0.0, 1.0) * 255));
                }
            }
        }
    }
    return picture;
}

} // namespace

class EditorWindow::Native
{
public:
    Native(const std::string& title, int width, int height)
    {
        @autoreleasepool
        {
            [NSApplication sharedApplication];
            [NSApp setActivationPolicy:NSApplicationActivationPolicyRegular];
            [NSApp finishLaunching];
            mDelegate = [[ZebhostWindowDelegate alloc] init];
            mWindow = [[NSWindow alloc] initWithContentRect:NSMakeRect(0, 0, width, height)
                                                  styleMask:NSWindowStyleMaskTitled | NSWindowStyleMaskClosable
                                                    backing:NSBackingStoreBuffered
                                                      defer:NO];
            if (mWindow == nil)
            {
                throw Failure(ExitCode::JobFailed, "there is no screen to open a window on: log in to the desktop");
            }
            [mWindow setReleasedWhenClosed:NO];
            [mWindow setDelegate:mDelegate];
            [mWindow setTitle:[NSString stringWithUTF8String:title.c_str()]];
            [mWindow center];
            [mWindow makeKeyAndOrderFront:nil];
            // The terminal that started this program is the active one.
            [NSApp activateIgnoringOtherApps:YES];
        }
    }

    ~Native()
    {
        [mWindow setDelegate:nil];
        [mWindow close];
        [mWindow release];
        [mDelegate release];
    }

    Native(const Native&) = delete;
    Native& operator=(const Native&) = delete;

    void* View() const { return [mWindow contentView]; }
    bool IsClosed() const { return [mDelegate closed] == YES; }
    void Resize(int width, int height) { [mWindow setContentSize:NSMakeSize(width, height)]; }

    void Update()
    {
        @autoreleasepool
        {
            while (NSEvent* event = [NSApp nextEventMatchingMask:NSEventMaskAny
                                                       untilDate:[NSDate distantPast]
                                                          inMode:NSDefaultRunLoopMode
                                                         dequeue:YES])
            {
                [NSApp sendEvent:event];
            }
        }
    }

    Picture TakePicture() const
    {
        @autoreleasepool
        {
            NSView* view = [mWindow contentView];
            NSBitmapImageRep* image = [view bitmapImageRepForCachingDisplayInRect:[view bounds]];
            if (image == nil)
            {
                return {};
            }
            [view cacheDisplayInRect:[view bounds] toBitmapImageRep:image];
            return ToPicture(image);
        }
    }

private:
    NSWindow* mWindow;
    ZebhostWindowDelegate* mDelegate;
};

EditorWindow::EditorWindow(const std::string& title, int width, int height)
    : mNative(std::make_unique<Native>(title, width, height))
{
}

EditorWindow::~EditorWindow() = default;

void* EditorWindow::Parent() const
{
    return mNative->View();
}

void EditorWindow::Resize(int width, int height)
{
    mNative->Resize(width, height);
}

void EditorWindow::Update()
{
    mNative->Update();
}

bool EditorWindow::IsClosed() const
{
    return mNative->IsClosed();
}

Picture EditorWindow::TakePicture() const
{
    return mNative->TakePicture();
}

} // namespace zebhost
