"""The command line: what was asked for, carried out on the server that was found, told step by step."""

import argparse
import contextlib
import fcntl
import os
import pathlib
import sys

from .catalogue import from_json
from .choices import Choices
from .servers.openpegasus import Open_Pegasus
from .servers.sfcb import Sfcb
from .steps import Failed, Not_Undone, Replace, carry_out
from .tools import Stopped, Store, Tools

DONE, FAILED, USAGE, NOT_UNDONE, NO_SERVER, IN_PART, NOT_ROOT, NOT_REGISTERED = range(8)
_SERVERS = {server.name: server for server in (Open_Pegasus, Sfcb)}
_STATE = "/var/lib/zmlr-register"

_EXIT_CODES = """exit status:
  0    done, or with --status: registered
  1    failed; what was done has been undone
  2    wrong options
  3    failed, and something could not be undone: run it again
  4    no CIM server was found, or several without --server
  5    done, without the classes for which the server's schema lacks something
  6    not run as root
  7    with --status: not registered, or not as this version would
  128+N  stopped by signal N; what was done has been undone"""


class No_Server(Failed):
    pass


def main(arguments=None, data=pathlib.Path(__file__).resolve().parent.parent):
    options = _parse(arguments)
    tools = Tools(options.dry_run, options.verbose)
    changing = not (options.status or options.dry_run)
    if changing and os.geteuid() != 0:
        tools.warn("only root can register the module (try --dry-run)")
        return NOT_ROOT
    os.umask(0o022)  # the server's user reads what is made for it, anybody asks for --status
    try:
        tools.listen_to_signals()
        with _alone(options.state) if changing else contextlib.nullcontext():
            return _run(options, tools, data)
    except (Failed, Stopped, OSError) as error:
        tools.warn(str(error))
        return _exit_code(error)


def _exit_code(error):
    if isinstance(error, Stopped):
        return 128 + error.number
    return {Not_Undone: NOT_UNDONE, No_Server: NO_SERVER}.get(type(error), FAILED)


def _parse(arguments):
    parser = argparse.ArgumentParser(
        prog="zmlr-register", description="Registers the Zemlar provider module with the CIM server of this host.",
        epilog=_EXIT_CODES, formatter_class=argparse.RawDescriptionHelpFormatter)
    task = parser.add_mutually_exclusive_group(required=True)
    task.add_argument("--install", action="store_true", help="register the module, or bring its registration up to date")
    task.add_argument("--update", action="store_true", help="bring up to date what is registered, with every server")
    task.add_argument("--remove", action="store_true", help="take the registration out again, of every server")
    task.add_argument("--status", action="store_true", help="tell what is registered, change nothing")
    parser.add_argument("--dry-run", action="store_true", help="tell what would be changed, change nothing")
    parser.add_argument("--verbose", "-v", action="store_true", help="tell every program that is run for a change")
    parser.add_argument("--server", choices=_SERVERS, help="which CIM server, when several are installed")
    parser.add_argument("--interop", metavar="NAME", help="the server's interop name space, when it has an unusual name")
    parser.add_argument("--schema", metavar="FILE", type=os.path.abspath, help="the CIM schema (CIM_Schema.mof) that the server works with")
    parser.add_argument("--provider-folder", metavar="DIR", type=os.path.abspath, help="where the server looks for provider modules")
    parser.add_argument("--staging", metavar="DIR", type=os.path.abspath, help="the staging folder of sfcb")
    parser.add_argument("--module", metavar="FILE", type=os.path.abspath,
                        help="the provider module, when it is not where it was installed")
    parser.add_argument("--state", metavar="DIR", default=_STATE, help=f"where registrations are noted ({_STATE})")
    return parser.parse_args(arguments)


@contextlib.contextmanager
def _alone(folder):
    """Only one run at a time. The folder goes when nothing is noted in it."""
    os.makedirs(folder, mode=0o755, exist_ok=True)
    descriptor = os.open(folder, os.O_RDONLY | os.O_DIRECTORY)
    try:
        fcntl.flock(descriptor, fcntl.LOCK_EX | fcntl.LOCK_NB)
        yield
        with contextlib.suppress(OSError):
            os.rmdir(folder)
    except BlockingIOError as error:
        raise Failed("zmlr-register is running already") from error
    finally:
        os.close(descriptor)


def _run(options, tools, data):
    """The exit status: that of the first server with which something is wrong."""
    catalogue = from_json((data / "registration" / "registration.json").read_text(encoding="utf-8"))
    store = Store(tools, options.state)
    statuses = [_run_with(server, options, tools, store, catalogue, data) for server in _choose_servers(options, tools, store)]
    return next(filter(None, statuses), DONE)


def _run_with(server_class, options, tools, store, catalogue, data):
    try:
        choices = Choices(store, server_class.name)
        options = choices.added_to(options)
        library = pathlib.Path(os.path.abspath(options.module or data / catalogue.file))
        server = server_class(tools, store, catalogue, options)
        tools.say(f"{server.title}, interop name space {server.interop}")
        if options.remove:
            carry_out([*server.removal(library), Replace(tools, choices, None)], tools)
            return DONE
        return _install(server, Replace(tools, choices, choices.text_of(options)), library, options, tools, data)
    except (Failed, OSError) as error:
        tools.warn(str(error))
        return _exit_code(error)


def _install(server, noting, library, options, tools, data):
    if not library.is_file():
        raise Failed(f"the module {library} is not there: name it with --module")
    mof = (data / "mof" / "zemlar.mof").read_text(encoding="utf-8")
    changes, left_out, lacks = server.changes(mof, library)
    for name_space, standard, missing, below in lacks:
        tools.warn(f"{standard} in {name_space} has no {', '.join(missing)}: clients do not see that of {', '.join(below)}")
    for name_space, cls, missing in left_out:
        tools.warn(f"left out: {cls.name} in {name_space}: the server has no {', '.join(missing)}")
    if options.status:
        return _status(tools, changes)
    carry_out([noting, *changes], tools)
    return IN_PART if left_out else DONE


def _choose_servers(options, tools, store):
    registered = [server for server in _SERVERS.values() if Choices(store, server.name).look() is not None]
    if options.update:
        registered = [server for server in registered if options.server in (None, server.name)]
        if not registered:
            tools.say("nothing is registered")
        return registered
    if options.server:
        return [_SERVERS[options.server]]
    if registered and not options.install:
        return registered
    found = [server for server in _SERVERS.values() if all(map(tools.find, server.programs))]
    if not found:
        raise No_Server("found neither OpenPegasus (cimmof, cimprovider, cimcli) nor sfcb (sfcbstage, sfcbunstage, sfcbrepos)")
    if len(found) > 1:
        raise No_Server(f"found {' and '.join(server.title for server in found)}: choose one with --server")
    return found


def _status(tools, changes):
    states = [(change.holder.title, change.state()) for change in changes if change.wanted is not None]
    for title, state in states:
        tools.say(f"{title}: {state}")
    return DONE if all(state == "as it should be" for _, state in states) else NOT_REGISTERED


if __name__ == "__main__":
    sys.exit(main())
