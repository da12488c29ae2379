// In world space.
uniform mat4 u_ViewProjection;

attribute vec3 a_position;

void main()
{
	gl_Position = u_ViewProjection * vec4(a_position, 1.0);
}
