#pragma once

#include "audiofilter/AudioFilterEditor.h"
#include "foundation/zebcore/MainThreadLoop.h"

#include <boost/smart_ptr/intrusive_ptr.hpp>

#include <memory>

namespace soak
{

/// A plug-in's editor, open in a window of its own for as long as this lives. [main]
class EditorWindow
{
public:
    /// Throws Fault if there is no display.
    explicit EditorWindow(const boost::intrusive_ptr<zebaudiofilterhost::AudioFilterEditor>& editor);
    ~EditorWindow();
    EditorWindow(const EditorWindow&) = delete;
    EditorWindow& operator=(const EditorWindow&) = delete;

    /// Takes the editor out of the window. The destructor does it too, and keeps to itself what that throws.
    void Close();

private:
    class Native;

    void Fit();
    void Tick();

    boost::intrusive_ptr<zebaudiofilterhost::AudioFilterEditor> mEditor;
    std::unique_ptr<Native> mWindow;
    boost::signals2::scoped_connection mSizeConnection;
    zebcore::threads::WatchID mTimer = zebcore::threads::kNoWatch;
};

} // namespace soak
