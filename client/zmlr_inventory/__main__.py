"""python -m zmlr_inventory"""

import sys

from .main import main

sys.exit(main())
