#pragma once

#include <cstdint>
#include <string>
#include <utility>

namespace Sarnik
{

/// What the shell, the formats and the interface fail with. An exception knows what the user is told: a task line
/// ("what could not be done") and an error line ("why"), both localised when asked for, and whether to tell anything at
/// all.
class CException
{
public:
    virtual ~CException() = default;

    /// Nothing at all is shown or heard.
    virtual bool Silent() const { return false; }
    /// An alert is shown; otherwise the alert sound is all.
    virtual bool ShowAlert() const { return true; }
    /// The lines in the user's language.
    std::string GetTaskString() const;
    std::string GetErrorString() const;
    /// The same as they stand in the code, to be localised.
    virtual std::string TaskText() const;
    virtual std::string ErrorText() const { return {}; }
    /// For whoever passes an exception on and knows better what could not be done. Only CError keeps them.
    virtual void SetTaskText(std::string) {}
    virtual void SetErrorText(std::string) {}
};

/// A failure with texts of its own; most give the error line only.
class CError : public CException
{
public:
    explicit CError(std::string errorText, bool beSilent = false, bool showAlert = true)
        : error(std::move(errorText)), silent(beSilent), alert(showAlert)
    {
    }
    CError(std::string taskText, std::string errorText, bool beSilent, bool showAlert)
        : task(std::move(taskText)), error(std::move(errorText)), silent(beSilent), alert(showAlert)
    {
    }

    bool Silent() const override { return silent; }
    bool ShowAlert() const override { return alert; }
    std::string TaskText() const override { return task; }
    std::string ErrorText() const override { return error; }
    void SetTaskText(std::string text) override { task = std::move(text); }
    void SetErrorText(std::string text) override { error = std::move(text); }

private:
    std::string task, error;
    bool silent, alert;
};

/// The user, or the host on the user's behalf, has cancelled.
class CAbort : public CException
{
public:
    explicit CAbort(bool beSilent, bool showAlert = true) : silent(beSilent), alert(showAlert) {}

    bool Silent() const override { return silent; }
    bool ShowAlert() const override { return alert; }
    std::string TaskText() const override;
    std::string ErrorText() const override;

private:
    bool silent, alert;
};

/// A failure that the host answered with one of its own codes.
class CTintorelError : public CException
{
public:
    explicit CTintorelError(std::int16_t hostCode) : code(hostCode) {}

    std::int16_t Code() const { return code; }
    std::string ErrorText() const override;

private:
    std::int16_t code;
};

/// A failure that the operating system explains.
class CSystemError : public CException
{
public:
    /// code: as in errno.
    explicit CSystemError(int systemCode) : code(systemCode) {}

    int Code() const { return code; }
    std::string ErrorText() const override;

private:
    int code;
};

} // namespace Sarnik
