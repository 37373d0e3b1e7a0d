"""The first line of a registration: which module it is for.

A server goes on with the module that it has loaded until it is registered anew, which happens when the text of the registration
differs. So the file's contents are told beside the version: a module that was built anew is another one.
"""

import hashlib


def heading(catalogue, library=None):
    """For a remark in the language of the registration; without a library, in the texts for whoever registers by hand."""
    contents = f", SHA-256 {hashlib.sha256(library.read_bytes()).hexdigest()}" if library else ""
    return f"{catalogue.module} {catalogue.version}{contents}\n"


def tell_another_module(tools, library, there, wanted):
    """Says so when the registration that is there is for another module than the one that is wanted."""
    if there and there.partition("\n")[0] != wanted.partition("\n")[0]:
        tools.say(f"{library.name} is another one than that which is registered: the server is to load it anew")
