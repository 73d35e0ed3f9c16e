#pragma once

#include <memory>
#include <string>
#include <vips/vips.h>

namespace Stillmark
{

/// Gives back a reference to one of libvips' objects.
struct vipsUnref
{
    void operator()(void *object) const { g_object_unref(object); }
};

using vipsImage = std::unique_ptr<VipsImage, vipsUnref>;
using vipsSource = std::unique_ptr<VipsSource, vipsUnref>;
using vipsTarget = std::unique_ptr<VipsTarget, vipsUnref>;

/// Starts libvips, once: no cache of results (a file may change under the same name), no loaders that are not meant for
/// files from strangers, no warnings on stderr. Throws std::runtime_error if it cannot be started.
void startVips();

/// What libvips has complained about since the last call, made one line; empty if nothing.
std::string takeVipsError();

} // namespace Stillmark
