#pragma once

#include "editor/Picture.h"

#include <memory>
#include <string>

namespace zebhost
{

// A window of the platform's for a plug-in's editor. [main]
class EditorWindow
{
public:
    // On the screen when this returns. Throws a Failure if there is no screen.
    EditorWindow(const std::string& title, int width, int height);
    ~EditorWindow();
    EditorWindow(const EditorWindow&) = delete;
    EditorWindow& operator=(const EditorWindow&) = delete;

    // What AudioFilterEditor::Open takes.
    void* Parent() const;
    void Resize(int width, int height);
    // Handles what has happened; to be called again and again. Shows what the plug-in has put into the window.
    void Update();
    // Whether the user has asked for the window to be closed. It stays until it is destroyed.
    bool IsClosed() const;
    // What can be seen of the window; empty if nothing can.
    Picture TakePicture() const;

private:
    class Native;
    std::unique_ptr<Native> mNative;
};

} // namespace zebhost
