#include <Node.h>

node_ref::node_ref()
	:
	device(0),
	node(0)
{
}

node_ref::node_ref(dev_t device, ino_t node)
	:
	device(device),
	node(node)
{
}

node_ref::node_ref(const node_ref& other) = default;

node_ref& node_ref::operator=(const node_ref& other) = default;

bool node_ref::operator==(const node_ref& other) const
{
	return device == other.device && node == other.node;
}

bool node_ref::operator!=(const node_ref& other) const
{
	return !(*this == other);
}

bool node_ref::operator<(const node_ref& other) const
{
	return device != other.device ? device < other.device : node < other.node;
}
