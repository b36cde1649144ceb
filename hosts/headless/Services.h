#pragma once

#include <cstdint>
#include <deque>
#include <functional>
#include <map>
#include <optional>
#include <random>
#include <string>

#include "frame/host.h"
#include "hosts/headless/Log.h"

/// The small services of the headless host. Each writes what it was asked into the log.
namespace tessel::headless {

class MemoryDisk;

class ScriptedLoop final : public frame::MessageLoop {
  public:
    explicit ScriptedLoop(Log& log) : log_(log) {}
    void Turn() override {
        log_.Add({"yield"});
        if (onTurn) onTurn();
    }

    std::function<void()> onTurn;  ///< what comes in meanwhile

  private:
    Log& log_;
};

/// Boxes that answer by themselves, from queues. With an empty queue a message box answers its default button (OK; Yes of Yes
/// and No), a file dialog is cancelled, a form is cancelled.
class ScriptedDialogs final : public frame::Dialogs {
  public:
    explicit ScriptedDialogs(Log& log) : log_(log) {}
    int MsgBox(const std::string& text, int style, const std::string& title) override;
    void ShowOpen(const std::string& title, const std::string& filter, std::string& fileName) override;
    void ShowModal(frame::Object& form) override;

    std::deque<int> answers;
    std::deque<std::optional<std::string>> fileNames;  ///< nothing for a cancelled dialog
    std::deque<std::function<void()>> forms;           ///< what the user does while a form is open
    std::function<void()> onMsgBox;                    ///< what happens while a message box is open

  private:
    Log& log_;
};

/// Menus whose entries are picked from a queue, by their paths.
class ScriptedMenus final : public frame::Menus {
  public:
    explicit ScriptedMenus(Log& log) : log_(log) {}
    void Popup(frame::Object& menu, frame::Object* defaultEntry) override;

    std::deque<std::function<void()>> picks;

  private:
    Log& log_;
};

class ScriptedDrag final : public frame::DragAndDrop {
  public:
    explicit ScriptedDrag(Log& log) : log_(log) {}
    void Start(frame::ChildControl& source) override;

  private:
    Log& log_;
};

class ScriptedFocus final : public frame::Focus {
  public:
    explicit ScriptedFocus(Log& log) : log_(log) {}
    void Set(frame::ChildControl& child) override;

  private:
    Log& log_;
};

/// A shell that opens and prints nothing. Results come from queues. With an empty queue opening and printing succeed, and an
/// operation on files is what `carryOut` makes of it; without that it succeeds too.
class ScriptedShell final : public frame::Shell {
  public:
    explicit ScriptedShell(Log& log) : log_(log) {}
    int Execute(std::string_view verb, const std::string& target) override;
    frame::FileOperationResult Run(const frame::FileOperation& operation) override;

    std::deque<int> executeResults;
    std::deque<frame::FileOperationResult> operationResults;
    std::function<frame::FileOperationResult(const frame::FileOperation&)> carryOut;

  private:
    Log& log_;
};

/// Random numbers from a queue, and behind it from a generator that repeats for the same seed.
class ScriptedRandom final : public frame::Random {
  public:
    float Next() override;
    void Restart(double seed) override;
    void RestartFromClock() override { Restart(0); }

    std::deque<float> queue;

  private:
    std::mt19937 generator_;
};

/// A fixed locale: "1,234.5", "2/3/2001 4:05:06 AM", "Saturday, February 3, 2001"; local time is Coordinated Universal Time.
class FixedLocale final : public frame::Locale {
  public:
    std::string DateText(frame::Date date) override;
    std::string LongDateText(frame::Date date) override;
    std::string Grouped(std::int64_t number) override;
    frame::Date LocalTime(std::int64_t seconds) override;
};

/// Every character is 6 pixels wide and every line 13 pixels high, in every font.
class FixedMetrics final : public frame::TextMetrics {
  public:
    frame::TextSize Measure(const frame::Font& font, std::string_view text, std::optional<float> wrapWidth) override;
};

/// Pictures of which the memory disk knows the size, and icons: one and the same small picture for every path, unless a queue says
/// that there is none.
class ScriptedPictures final : public frame::PictureLoader {
  public:
    ScriptedPictures(Log& log, MemoryDisk& disk) : log_(log), disk_(disk) {}
    /// Error 481 for a file that has no picture.
    frame::PictureRef LoadPicture(const std::string& fileName) override;
    frame::PictureRef FileIcon(const std::string& path, int flags) override;

    std::deque<bool> icons;  ///< whether the system has an icon for the next path asked; true when the queue is empty
    std::function<void(const std::string&)> onIcon;  ///< what happens while it is asked for that of a path

  private:
    Log& log_;
    MemoryDisk& disk_;
};

class FixedApplication final : public frame::Application {
  public:
    std::string Path() override { return path; }
    int ScreenMousePointer() override { return pointer; }
    void SetScreenMousePointer(int value) override { pointer = value; }

    std::string path = "C:\\App";
    int pointer = 0;
};

class MemoryClipboard final : public frame::Clipboard {
  public:
    void Clear() override;
    bool Has(int format) override { return contents.contains(format); }
    bool Put(int format, std::string bytes) override;
    std::optional<std::string> Read(int format) override;

    std::map<int, std::string> contents;
    bool held = false;  ///< another program holds it
};

/// Where unhandled errors gather.
class ErrorList final : public frame::ErrorSink {
  public:
    struct Report {
        frame::ControlError error;
        std::string where;
    };
    void Unhandled(const frame::ControlError& error, const std::string& where) override { reports.push_back({error, where}); }

    std::vector<Report> reports;
};

}  // namespace tessel::headless
