#pragma once

namespace Sarnik
{

/// A process-wide object that exists at most once and is built when it is first asked for. Those that exist form a
/// list; ShutdownAll ends them in the reverse order of their first use. Main thread.
class CService
{
public:
    CService(const CService &) = delete;
    CService &operator=(const CService &) = delete;
    virtual ~CService() = default;

    /// Ends every service. A service that the end of another asks for is built again and ended by the same call.
    static void ShutdownAll();

protected:
    CService() = default;
    virtual void Shutdown() = 0;
    /// Puts the service at the head of the list.
    void Link() noexcept;

private:
    CService *next = nullptr;
};

/// The service of a class. Its accessor is a function with one static CServiceT:
///
///     CReporter *CReporter::Get(bool create)
///     {
///         static CServiceT<CReporter> service;
///         return service.Get(create);
///     }
template <class T> class CServiceT : public CService
{
public:
    /// The object; null when there is none and `create` is false, or where it could not be made without an exception.
    T *Get(bool create)
    {
        if (instance == nullptr && create)
        {
            instance = Create();
            if (instance != nullptr)
                Link();
        }
        return instance;
    }

protected:
    virtual T *Create() { return new T; }
    void Shutdown() override
    {
        delete instance;
        instance = nullptr;
    }

private:
    T *instance = nullptr;
};

} // namespace Sarnik
