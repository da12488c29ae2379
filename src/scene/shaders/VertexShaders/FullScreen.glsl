// A full-screen quad, whose corners are those of clip space, with the picture that covers it.
attribute vec3 a_position;

varying vec2 v_UV;

void main()
{
	v_UV = 0.5 * a_position.xy + 0.5;
	gl_Position = vec4(a_position, 1.0);
}
