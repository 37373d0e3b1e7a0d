"""The instances that make OpenPegasus know the module: for its interop name space."""

import re

from ..catalogue import select_all
from ..heading import heading

# The values of PG_ProviderCapabilities.ProviderType and of PG_ProviderModule.UserContext.
_KINDS = {"instance": 2, "association": 3, "indication": 4, "method": 5}
_PRIVILEGED_USER = 4  # opens the device nodes, and is one for all clients: they see the same jobs and records

_MODULE = """instance of PG_ProviderModule
{{
    Name             = "{module}";
    Vendor           = "{vendor}";
    Version          = "{version}";
    InterfaceType    = "CMPI";
    InterfaceVersion = "2.0.0";
    Location         = "{location}";
    UserContext      = {user_context};
}};
"""
_PROVIDER = """
instance of PG_Provider
{{
    ProviderModuleName = "{module}";
    Name               = "{provider}";
}};

instance of PG_ProviderCapabilities
{{
    ProviderModuleName  = "{module}";
    ProviderName        = "{provider}";
    CapabilityID        = "{cls}";
    ClassName           = "{cls}";
    Namespaces          = {{{name_spaces}}};
    ProviderType        = {{{kinds}}};
    SupportedProperties = NULL;
    SupportedMethods    = NULL;
}};
"""


def registration_mof(catalogue, selection, library=None):
    """The instances that make the server know the module, for its interop name space; `library` is the file that they are for."""
    texts = ["// " + heading(catalogue, library),
             _MODULE.format(module=catalogue.module, vendor=catalogue.vendor, version=catalogue.version,
                            location=catalogue.location, user_context=_PRIVILEGED_USER)]
    for cls in selection.provided:
        texts.append(_PROVIDER.format(module=catalogue.module, provider=cls.provider, cls=cls.name,
                                      name_spaces=", ".join(f'"{name}"' for name in selection.name_spaces(cls)),
                                      kinds=", ".join(str(_KINDS[kind]) for kind in cls.kinds)))
    return "".join(texts)


def providers_of(registration):
    """The names of the providers of a registration."""
    return re.findall(r'^    ProviderName +=  *"(\w+)"', registration, re.MULTILINE)


def full_registration(catalogue):
    """With every class, for a server that calls its interop name space as usual."""
    return registration_mof(catalogue, select_all(catalogue, "root/PG_InterOp"))
