"""The inventory of hosts with Zemlar adapters, read from their CIM servers."""

__version__ = "2.2.0"
