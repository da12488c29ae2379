// A full-screen quad, whose corners are those of clip space.
attribute vec3 a_position;

void main()
{
	gl_Position = vec4(a_position, 1.0);
}
