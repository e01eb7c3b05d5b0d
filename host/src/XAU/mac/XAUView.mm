#include "host/src/XAU/src/XAUView.h"

#include "host/src/XAU/src/CallGuarded.h"

#import <AppKit/AppKit.h>
#import <AudioUnit/AUCocoaUIView.h>
#import <CoreAudioKit/CoreAudioKit.h>

#include <cstdlib>

// Told of the view's new frames.
@interface WindowResizeDelegate : NSObject
{
@public
    NSView* mNSView;
    boost::function<void()> mResized;
}
- (void)viewResized:(NSNotification*)notification;
@end

@implementation WindowResizeDelegate
- (void)viewResized:(NSNotification*)notification
{
    (void)notification;
    if (mResized)
        mResized();
}
@end

namespace zebaudiofilterhost::xau
{

namespace
{

// References of CoreFoundation are pointers to Foundation's objects of the same name.
template <class Object>
Object* ToObject(const void* reference)
{
    return static_cast<Object*>(const_cast<void*>(reference));
}

// What the unit makes by its own factory. Null where something of it cannot be had.
NSView* MakeCocoaView(AudioUnit unit)
{
    UInt32 size = 0;
    Boolean isWritable = 0;
    if (CallGuarded<AudioUnitGetPropertyInfo>(unit, kAudioUnitProperty_CocoaUI, kAudioUnitScope_Global, 0, &size,
                                              &isWritable) != noErr ||
        size < sizeof(AudioUnitCocoaViewInfo))
        return nil;
    auto* info = static_cast<AudioUnitCocoaViewInfo*>(std::malloc(size));
    if (!info)
        return nil;
    NSView* view = nil;
    if (CallGuarded<AudioUnitGetProperty>(unit, kAudioUnitProperty_CocoaUI, kAudioUnitScope_Global, 0, info, &size) ==
            noErr &&
        size >= sizeof(AudioUnitCocoaViewInfo))
    {
        NSURL* location = ToObject<NSURL>(info->mCocoaAUViewBundleLocation);
        NSString* className = ToObject<NSString>(info->mCocoaAUViewClass[0]);
        NSBundle* bundle = location && className ? [NSBundle bundleWithPath:[location path]] : nil;
        if (location && className && !bundle)
            NSLog(@"Error loading AU view's bundle");
        id factory = [[[[bundle classNamed:className] alloc] init] autorelease];
        if (factory)
        {
            view = [[factory uiViewForAudioUnit:unit withSize:NSMakeSize(200, 200)] retain];
            if (location)
                CFRelease(location);
        }
        const UInt32 classes = (size - sizeof(CFURLRef)) / sizeof(CFStringRef);
        for (UInt32 index = 0; index < classes; ++index)
        {
            if (info->mCocoaAUViewClass[index])
                CFRelease(info->mCocoaAUViewClass[index]);
        }
    }
    std::free(info);
    return view;
}

NSView* MakeGenericView(AudioUnit unit)
{
    AUGenericView* view = [[AUGenericView alloc] initWithAudioUnit:unit];
    [view setShowsExpertParameters:YES];
    return view;
}

class CocoaView : public XAUView
{
public:
    CocoaView(NSView* view, NSView* parent, const boost::function<void()>& resized)
        : mView(view)
        , mContainer([[NSView alloc] initWithFrame:[view frame]])
        , mDelegate([[WindowResizeDelegate alloc] init])
    {
        [parent addSubview:mContainer];
        [mContainer setAutoresizesSubviews:NO];
        [mContainer addSubview:mView];
        mDelegate->mNSView = mView;
        mDelegate->mResized = resized;
        [[NSNotificationCenter defaultCenter] addObserver:mDelegate
                                                 selector:@selector(viewResized:)
                                                     name:NSViewFrameDidChangeNotification
                                                   object:mView];
    }

    ~CocoaView() override
    {
        [[NSNotificationCenter defaultCenter] removeObserver:mDelegate];
        [mContainer removeFromSuperview];
        [mDelegate release];
        [mContainer release];
        [mView release];
    }

    float GetWidth() const override { return static_cast<float>([mView frame].size.width); }
    float GetHeight() const override { return static_cast<float>([mView frame].size.height); }

    void FitFrame() override
    {
        const NSSize size = [mView frame].size;
        [mContainer setFrame:NSMakeRect(0, 0, size.width, size.height)];
        [mContainer setNeedsDisplay:YES];
    }

private:
    NSView* mView;
    NSView* mContainer;
    WindowResizeDelegate* mDelegate;
};

} // namespace

std::unique_ptr<XAUView> OpenXAUView(AudioUnit unit, int viewClasses, void* parent,
                                     const boost::function<void()>& resized)
{
    NSView* view = viewClasses != 0 ? MakeCocoaView(unit) : nil;
    if (!view)
        view = MakeGenericView(unit);
    if (!view)
        return nullptr;
    return std::make_unique<CocoaView>(view, static_cast<NSView*>(parent), resized);
}

} // namespace zebaudiofilterhost::xau
