"""Changes that can be undone: each brings something that the server holds to what is wanted, and back to what was there."""

from abc import ABC, abstractmethod

AS_IT_SHOULD_BE = "as it should be"


class Failed(Exception):
    """What could not be done, in words for the administrator."""


class Not_Undone(Failed):
    """A failure after which something stayed changed."""


class Holder(ABC):
    """A place of the server that holds something or nothing: the classes of a name space, a registration, a link."""

    def __init__(self, title):
        self.title = title

    @abstractmethod
    def look(self):
        """What is there: None when nothing is, an empty text when it is there in part."""

    @abstractmethod
    def put(self, text):
        """Brings what is wanted to where nothing is."""

    @abstractmethod
    def drop(self, text):
        """Takes away whatever of the text is there, which may be a part of it or nothing."""


class Replace:
    """Brings a holder to what is wanted; None empties it. `earlier` is a change of the same holder that comes before."""

    def __init__(self, tools, holder, wanted, earlier=None):
        self._tools = tools
        self.holder = holder
        self.wanted = wanted
        self._earlier = earlier
        self._before = None
        self.changed = False

    def state(self):
        there = self.holder.look()
        return AS_IT_SHOULD_BE if there == self.wanted else "missing" if there is None else "in part, or for another module"

    def apply(self):
        before = self._earlier.wanted if self._earlier else self.holder.look()
        if before == self.wanted:
            self._tell(AS_IT_SHOULD_BE if before else "nothing there")
            return
        self._before, self.changed = before, True
        if before is not None:
            self._tell("removing")
            self.holder.drop(before)
        if self.wanted is not None:
            self._tell("adding")
            self.holder.put(self.wanted)

    def revert(self):
        if not self.changed:
            return
        self._tell("undoing")
        if self.wanted is not None:
            self.holder.drop(self.wanted)
        if self._before:
            self.holder.drop(self._before)  # a removal that failed may have left a part
            self.holder.put(self._before)

    def _tell(self, what):
        self._tools.say(f"{self.holder.title}: {what}")


class Refresh:
    """Makes a server take in what changes left for it: after them, or when standing before them, after their undoing.

    refresh(changed) is told whether any of them changed something.
    """

    def __init__(self, refresh, changes, undoing):
        self._refresh = refresh
        self._changes = changes
        self._undoing = undoing
        self.wanted = None

    def apply(self):
        if not self._undoing:
            self._refresh(any(change.changed for change in self._changes))

    def revert(self):
        if self._undoing:
            self._refresh(any(change.changed for change in self._changes))


def carry_out(steps, tools):
    """All of them, or none: what was begun is undone in reverse. Raises Failed, or Not_Undone when something stayed."""
    begun = []
    try:
        for step in steps:
            begun.append(step)
            step.apply()
    except BaseException as error:
        tools.begin_undoing()
        stuck = [words for words in map(_undo, reversed(begun)) if words]
        if stuck:
            raise Not_Undone("; ".join([str(error), *(f"could not undo: {words}" for words in stuck)])) from error
        tools.say("undone: everything is as it was before")
        raise


def _undo(step):
    """Why a step could not be undone, else nothing; the others are undone all the same."""
    try:
        step.revert()
    except (Failed, OSError) as error:
        return str(error)
    return ""
