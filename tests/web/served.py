# Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

"""
The server that the tests use. It is constructed with a Machine and, where a test needs a history,
`past`: a function that returns the reading of a node some seconds ago. It has `address`, `start`,
`stop` and `restart`, and follows the changes of the machine.
"""

from stand_in import StandIn as Server, wave  # noqa: F401  pylint: disable=unused-import
