#include "host/plugin/propertyTable.h"

#include <span>
#include <string_view>

namespace Stillmark
{

propertyTable::propertyTable(runState &run, handleTable &hostMemory, const hostOptions &options)
    : state(run), handles(hostMemory)
{
    numbers[{TN_PROPERTY_SIGNATURE, TN_PROPERTY_PLAYING}] = options.playing;
    if (options.version)
        numbers[{TN_PROPERTY_SIGNATURE, TN_PROPERTY_VERSION}] = *options.version;
    if (options.threads > 0)
        numbers[{threadsSignature, threadsKey}] = options.threads;
    for (const auto &[key, number] : options.properties)
        numbers[{TN_PROPERTY_SIGNATURE, key}] = number;

    table.context = this;
    table.get = [](void *context, std::uint32_t signature, std::uint32_t key, std::int32_t, std::intptr_t *number,
                   TNHandle *text) {
        propertyTable &all = *static_cast<propertyTable *>(context);
        return all.state.code("get of a property", [&] { return all.get(signature, key, number, text); });
    };
    table.set = [](void *context, std::uint32_t signature, std::uint32_t key, std::int32_t, std::intptr_t) {
        propertyTable &all = *static_cast<propertyTable *>(context);
        return all.state.code("set of a property", [&] { return all.set(signature, key); });
    };
}

/// Nonsense is a text where a number is due.
TNError propertyTable::get(std::uint32_t signature, std::uint32_t key, std::intptr_t *number, TNHandle *text)
{
    const hostLie lie = state.lie(hostCall::property, keyText(key));
    if (lie.fails())
        return lie.code;
    if (!number || !text)
        return TNErrParameter;
    *number = 0;
    *text = nullptr;
    if (lie.raves())
    {
        static constexpr std::string_view words = "nonsense";
        *text = handles.create(std::span(reinterpret_cast<const std::uint8_t *>(words.data()), words.size()));
        return TNNoError;
    }
    const auto place = numbers.find({signature, key});
    if (place == numbers.end())
        return TNErrParameter;
    *number = place->second;
    return TNNoError;
}

/// The wait cursor's suspension is all that can be set; there is no cursor here.
TNError propertyTable::set(std::uint32_t signature, std::uint32_t key)
{
    const hostLie lie = state.lie(hostCall::property, keyText(key));
    if (lie.fails())
        return lie.code;
    return signature == TN_PROPERTY_SIGNATURE && key == TN_PROPERTY_WATCH ? TNNoError : TNErrParameter;
}

} // namespace Stillmark
