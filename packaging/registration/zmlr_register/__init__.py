"""zmlr-register: registers the provider module with the CIM server of the host, and removes it again."""
