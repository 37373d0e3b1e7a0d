"""The CIM servers that the module can be registered with."""
