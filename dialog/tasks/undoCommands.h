#pragma once

namespace Sarnik
{
class CCommandMessage;
}

namespace Project
{

class PTaskHost;

/// The commands sarnik/command/undo, redo, undoRedo, stepBackward and stepForward. While a trace is estimating nothing
/// is undone; undoRedo, the one-key toggle, stops all estimations then.

/// Whether it is one of them; if so, it has been carried out, as far as it was enabled. What a task throws goes on.
bool ReceiveUndoCommand(PTaskHost &host, const Sarnik::CCommandMessage &command);
/// Whether it is one of them; if so, the answers are filled in.
bool UpdateUndoCommand(PTaskHost &host, Sarnik::CCommandMessage &command);

} // namespace Project
