"""A reader of MOF class declarations: enough of the language for classes, and every check a MOF compiler makes of them."""
